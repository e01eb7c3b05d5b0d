#pragma once

#include <cstdint>

namespace zebaudiofilterhost
{

/// What a filter does, for the menus of an application. The numbers stand in settings files, so they never change:
/// 1 to 10 follow the categories of VST 2, 11 to 26 the sub-categories of VST 3.
enum AudioFilterCategory : std::int32_t
{
    kCategoryNone = 0,
    kCategoryEffect = 1,
    kCategorySynth = 2,
    kCategoryAnalysis = 3,
    kCategoryMastering = 4,
    kCategorySpacializer = 5,
    kCategoryRoomFx = 6,
    kCategorySurroundFx = 7,
    kCategoryRestoration = 8,
    kCategoryOfflineProcess = 9,
    kCategoryGenerator = 10,
    kCategoryVST3Analyzer = 11,
    kCategoryVST3Delay = 12,
    kCategoryVST3Distortion = 13,
    kCategoryVST3Dynamics = 14,
    kCategoryVST3EQ = 15,
    kCategoryVST3Filter = 16,
    kCategoryVST3Instrument = 17,
    kCategoryVST3Spatial = 18,
    kCategoryVST3Generator = 19,
    kCategoryVST3Mastering = 20,
    kCategoryVST3Modulation = 21,
    kCategoryVST3PitchShift = 22,
    kCategoryVST3Restoration = 23,
    kCategoryVST3Reverb = 24,
    kCategoryVST3Surround = 25,
    kCategoryVST3Tools = 26,
    kCategoryNotQueried = 27 // the scan did not ask the plug-in
};

} // namespace zebaudiofilterhost
