#pragma once

#include <cstddef>
#include <cstdint>

/// The published binary interface of VST 2.4 as far as hosts and effects meet here: names, numbers and layouts, for
/// 64-bit processes. Layouts are those of 8-byte packing, which x86-64 has by itself; the assertions at the end hold
/// them. Texts are zero-ended bytes in buffers of the caller's; where a plug-in takes the published length for short,
/// a caller has the longer buffer.
namespace zebaudiofilterhost::vst
{

struct AEffect;

/// Given to the entry point, called by the plug-in from any thread. `value` and the result carry pointers as well.
using audioMasterCallback = long long (*)(AEffect* effect, std::int32_t opcode, std::int32_t index, long long value,
                                          void* ptr, float opt);

using AEffectDispatcherProc = long long (*)(AEffect* effect, std::int32_t opcode, std::int32_t index, long long value,
                                            void* ptr, float opt);
using AEffectProcessProc = void (*)(AEffect* effect, float** inputs, float** outputs, std::int32_t sampleFrames);
using AEffectProcessDoubleProc = void (*)(AEffect* effect, double** inputs, double** outputs,
                                          std::int32_t sampleFrames);
using AEffectSetParameterProc = void (*)(AEffect* effect, std::int32_t index, float parameter);
using AEffectGetParameterProc = float (*)(AEffect* effect, std::int32_t index);

/// "VSTPluginMain", on older plug-ins "main_macho" or "main". Null: the plug-in refuses this host.
using VSTPluginMainProc = AEffect* (*)(audioMasterCallback host);

inline constexpr std::int32_t kEffectMagic = 0x56737450; // "VstP"

/// One instance. The plug-in owns it, from the entry call to effClose.
struct AEffect
{
    std::int32_t magic;
    AEffectDispatcherProc dispatcher;
    AEffectProcessProc process; // adds to the outputs; superseded by processReplacing
    AEffectSetParameterProc setParameter;
    AEffectGetParameterProc getParameter;
    std::int32_t numPrograms;
    std::int32_t numParams;
    std::int32_t numInputs;
    std::int32_t numOutputs;
    std::int32_t flags;
    std::intptr_t resvd1; // the host's
    std::intptr_t resvd2; // the host's
    std::int32_t initialDelay;
    std::int32_t realQualities;
    std::int32_t offQualities;
    float ioRatio;
    void* object; // the plug-in's
    void* user;   // the host's
    std::int32_t uniqueID;
    std::int32_t version;
    AEffectProcessProc processReplacing;
    AEffectProcessDoubleProc processDoubleReplacing;
    char future[56];
};

enum VstAEffectFlags : std::int32_t
{
    effFlagsHasEditor = 1 << 0,
    effFlagsHasClip = 1 << 1,
    effFlagsHasVu = 1 << 2,
    effFlagsCanMono = 1 << 3,
    effFlagsCanReplacing = 1 << 4,
    effFlagsProgramChunks = 1 << 5,
    effFlagsIsSynth = 1 << 8,
    effFlagsNoSoundInStop = 1 << 9,
    effFlagsExtIsAsync = 1 << 10,
    effFlagsExtHasBuffer = 1 << 11,
    effFlagsCanDoubleReplacing = 1 << 12
};

/// What the host asks of the plug-in. Names first: the arguments in use.
enum AEffectOpcodes : std::int32_t
{
    effOpen = 0,
    effClose = 1,
    effSetProgram = 2,      // value: program
    effGetProgram = 3,      // result: program
    effSetProgramName = 4,  // ptr: char*
    effGetProgramName = 5,  // ptr: char[24]
    effGetParamLabel = 6,   // index: parameter; ptr: char[8]
    effGetParamDisplay = 7, // index: parameter; ptr: char[8]
    effGetParamName = 8,    // index: parameter; ptr: char[8]
    effGetVu = 9,
    effSetSampleRate = 10, // opt: hertz
    effSetBlockSize = 11,  // value: frames
    effMainsChanged = 12,  // value: 1 on, 0 off
    effEditGetRect = 13,   // ptr: ERect**
    effEditOpen = 14,      // ptr: the parent window
    effEditClose = 15,
    effEditDraw = 16,
    effEditMouse = 17,
    effEditKey = 18,
    effEditIdle = 19,
    effEditTop = 20,
    effEditSleep = 21,
    effIdentify = 22,
    effGetChunk = 23, // index: 0 bank, 1 program; ptr: void**; result: bytes
    effSetChunk = 24, // index: 0 bank, 1 program; value: bytes; ptr: the bytes
    effProcessEvents = 25,
    effCanBeAutomated = 26, // index: parameter; result: 1 if so
    effString2Parameter = 27,
    effGetNumProgramCategories = 28,
    effGetProgramNameIndexed = 29, // index: program; value: category or -1; ptr: char[24]; result: 1 if there is one
    effCopyProgram = 30,
    effConnectInput = 31,
    effConnectOutput = 32,
    effGetInputProperties = 33,
    effGetOutputProperties = 34,
    effGetPlugCategory = 35, // result: VstPlugCategory
    effGetCurrentPosition = 36,
    effGetDestinationBuffer = 37,
    effOfflineNotify = 38,
    effOfflinePrepare = 39,
    effOfflineRun = 40,
    effProcessVarIo = 41,
    effSetSpeakerArrangement = 42, // value: input, ptr: output VstSpeakerArrangement*; result: 1 if taken
    effSetBlockSizeAndSampleRate = 43,
    effSetBypass = 44,
    effGetEffectName = 45, // ptr: char[32]
    effGetErrorText = 46,
    effGetVendorString = 47,  // ptr: char[64]
    effGetProductString = 48, // ptr: char[64]
    effGetVendorVersion = 49,
    effVendorSpecific = 50,
    effCanDo = 51, // ptr: char*; result: 1 yes, -1 no, 0 don't know
    effGetTailSize = 52,
    effIdle = 53,
    effGetIcon = 54,
    effSetViewPosition = 55,
    effGetParameterProperties = 56, // index: parameter; ptr: VstParameterProperties*; result: 1 if filled
    effKeysRequired = 57,
    effGetVstVersion = 58, // result: 2400 and the like; 2 or less: VST 2.0 or older
    effEditKeyDown = 59,
    effEditKeyUp = 60,
    effSetEditKnobMode = 61,
    effGetMidiProgramName = 62,
    effGetCurrentMidiProgram = 63,
    effGetMidiProgramCategory = 64,
    effHasMidiProgramsChanged = 65,
    effGetMidiKeyName = 66,
    effBeginSetProgram = 67,
    effEndSetProgram = 68,
    effGetSpeakerArrangement = 69, // value: VstSpeakerArrangement** input; ptr: ** output; result: 1 if filled
    effShellGetNextPlugin = 70,    // ptr: char[64]; result: the next member's unique ID, 0 at the end
    effStartProcess = 71,
    effStopProcess = 72,
    effSetTotalSampleToProcess = 73,
    effSetPanLaw = 74,
    effBeginLoadBank = 75,
    effBeginLoadProgram = 76,
    effSetProcessPrecision = 77,
    effGetNumMidiInputChannels = 78,
    effGetNumMidiOutputChannels = 79
};

/// What the plug-in asks of the host.
enum AudioMasterOpcodes : std::int32_t
{
    audioMasterAutomate = 0,  // index: parameter; opt: value
    audioMasterVersion = 1,   // result: 2400 and the like
    audioMasterCurrentId = 2, // result: unique ID of the shell's member to make
    audioMasterIdle = 3,
    audioMasterPinConnected = 4, // index: pin; value: 0 input, 1 output; result: 0 connected
    audioMasterWantMidi = 6,
    audioMasterGetTime = 7, // value: wanted flags; result: VstTimeInfo*
    audioMasterProcessEvents = 8,
    audioMasterSetTime = 9,
    audioMasterTempoAt = 10,
    audioMasterGetNumAutomatableParameters = 11,
    audioMasterGetParameterQuantization = 12,
    audioMasterIOChanged = 13,
    audioMasterNeedIdle = 14,
    audioMasterSizeWindow = 15, // index: width; value: height
    audioMasterGetSampleRate = 16,
    audioMasterGetBlockSize = 17,
    audioMasterGetInputLatency = 18,
    audioMasterGetOutputLatency = 19,
    audioMasterGetPreviousPlug = 20,
    audioMasterGetNextPlug = 21,
    audioMasterWillReplaceOrAccumulate = 22,
    audioMasterGetCurrentProcessLevel = 23,
    audioMasterGetAutomationState = 24,
    audioMasterOfflineStart = 25,
    audioMasterOfflineRead = 26,
    audioMasterOfflineWrite = 27,
    audioMasterOfflineGetCurrentPass = 28,
    audioMasterOfflineGetCurrentMetaPass = 29,
    audioMasterSetOutputSampleRate = 30,
    audioMasterGetOutputSpeakerArrangement = 31,
    audioMasterGetVendorString = 32,  // ptr: char[64]
    audioMasterGetProductString = 33, // ptr: char[64]
    audioMasterGetVendorVersion = 34,
    audioMasterVendorSpecific = 35,
    audioMasterSetIcon = 36,
    audioMasterCanDo = 37, // ptr: char*; result: 1 yes, 0 don't know
    audioMasterGetLanguage = 38,
    audioMasterOpenWindow = 39,
    audioMasterCloseWindow = 40,
    audioMasterGetDirectory = 41,
    audioMasterUpdateDisplay = 42,
    audioMasterBeginEdit = 43, // index: parameter
    audioMasterEndEdit = 44,   // index: parameter
    audioMasterOpenFileSelector = 45,
    audioMasterCloseFileSelector = 46,
    audioMasterEditFile = 47,
    audioMasterGetChunkFile = 48,
    audioMasterGetInputSpeakerArrangement = 49
};

enum VstPlugCategory : std::int32_t
{
    kPlugCategUnknown = 0,
    kPlugCategEffect = 1,
    kPlugCategSynth = 2,
    kPlugCategAnalysis = 3,
    kPlugCategMastering = 4,
    kPlugCategSpacializer = 5,
    kPlugCategRoomFx = 6,
    kPlugSurroundFx = 7,
    kPlugCategRestoration = 8,
    kPlugCategOfflineProcess = 9,
    kPlugCategShell = 10,
    kPlugCategGenerator = 11
};

enum VstHostLanguage : std::int32_t
{
    kVstLangEnglish = 1,
    kVstLangGerman = 2,
    kVstLangFrench = 3,
    kVstLangItalian = 4,
    kVstLangSpanish = 5,
    kVstLangJapanese = 6
};

/// Where the host stands; which members count is said by `flags`.
struct VstTimeInfo
{
    double samplePos;
    double sampleRate; // hertz
    double nanoSeconds;
    double ppqPos; // quarter notes
    double tempo;  // beats a minute
    double barStartPos;
    double cycleStartPos;
    double cycleEndPos;
    std::int32_t timeSigNumerator;
    std::int32_t timeSigDenominator;
    std::int32_t smpteOffset;
    std::int32_t smpteFrameRate;
    std::int32_t samplesToNextClock;
    std::int32_t flags;
};

enum VstTimeInfoFlags : std::int32_t
{
    kVstTransportChanged = 1 << 0,
    kVstTransportPlaying = 1 << 1,
    kVstTransportCycleActive = 1 << 2,
    kVstTransportRecording = 1 << 3,
    kVstAutomationWriting = 1 << 6,
    kVstAutomationReading = 1 << 7,
    kVstNanosValid = 1 << 8,
    kVstPpqPosValid = 1 << 9,
    kVstTempoValid = 1 << 10,
    kVstBarsValid = 1 << 11,
    kVstCyclePosValid = 1 << 12,
    kVstTimeSigValid = 1 << 13,
    kVstSmpteValid = 1 << 14,
    kVstClockValid = 1 << 15
};

enum VstSmpteFrameRate : std::int32_t
{
    kVstSmpte24fps = 0,
    kVstSmpte25fps = 1
};

struct VstParameterProperties
{
    float stepFloat;
    float smallStepFloat;
    float largeStepFloat;
    char label[64];
    std::int32_t flags;
    std::int32_t minInteger;
    std::int32_t maxInteger;
    std::int32_t stepInteger;
    std::int32_t largeStepInteger;
    char shortLabel[8];
    std::int16_t displayIndex;
    std::int16_t category;
    std::int16_t numParametersInCategory;
    std::int16_t reserved;
    char categoryLabel[24];
    char future[16];
};

enum VstParameterFlags : std::int32_t
{
    kVstParameterIsSwitch = 1 << 0,
    kVstParameterUsesIntegerMinMax = 1 << 1,
    kVstParameterUsesFloatStep = 1 << 2,
    kVstParameterUsesIntStep = 1 << 3,
    kVstParameterSupportsDisplayIndex = 1 << 4,
    kVstParameterSupportsDisplayCategory = 1 << 5,
    kVstParameterCanRamp = 1 << 6
};

struct VstSpeakerProperties
{
    float azimuth;   // radians
    float elevation; // radians
    float radius;    // metres
    float reserved;
    char name[64];
    std::int32_t type; // VstSpeakerType
    char future[28];
};

/// Eight speakers are declared; one with more channels goes on behind them.
struct VstSpeakerArrangement
{
    std::int32_t type; // VstSpeakerArrangementType
    std::int32_t numChannels;
    VstSpeakerProperties speakers[8];
};

enum VstSpeakerType : std::int32_t
{
    kSpeakerUndefined = 0x7fffffff,
    kSpeakerM = 0,
    kSpeakerL = 1,
    kSpeakerR = 2,
    kSpeakerC = 3,
    kSpeakerLfe = 4,
    kSpeakerLs = 5,
    kSpeakerRs = 6,
    kSpeakerLc = 7,
    kSpeakerRc = 8,
    kSpeakerS = 9,
    kSpeakerSl = 10,
    kSpeakerSr = 11
};

enum VstSpeakerArrangementType : std::int32_t
{
    kSpeakerArrUserDefined = -2,
    kSpeakerArrEmpty = -1,
    kSpeakerArrMono = 0,
    kSpeakerArrStereo = 1,
    kSpeakerArr50 = 14,
    kSpeakerArr51 = 15,
    kSpeakerArr71Cine = 22,
    kSpeakerArr71Music = 23
};

/// An editor's place in its parent, in pixels.
struct ERect
{
    std::int16_t top;
    std::int16_t left;
    std::int16_t bottom;
    std::int16_t right;
};

static_assert(sizeof(void*) == 8, "the layouts below are those of 64-bit processes");
static_assert(offsetof(AEffect, dispatcher) == 8);
static_assert(offsetof(AEffect, process) == 16);
static_assert(offsetof(AEffect, setParameter) == 24);
static_assert(offsetof(AEffect, getParameter) == 32);
static_assert(offsetof(AEffect, numPrograms) == 40);
static_assert(offsetof(AEffect, numParams) == 44);
static_assert(offsetof(AEffect, numInputs) == 48);
static_assert(offsetof(AEffect, numOutputs) == 52);
static_assert(offsetof(AEffect, flags) == 56);
static_assert(offsetof(AEffect, resvd1) == 64);
static_assert(offsetof(AEffect, initialDelay) == 80);
static_assert(offsetof(AEffect, object) == 96);
static_assert(offsetof(AEffect, uniqueID) == 112);
static_assert(offsetof(AEffect, version) == 116);
static_assert(offsetof(AEffect, processReplacing) == 120);
static_assert(offsetof(AEffect, processDoubleReplacing) == 128);
static_assert(sizeof(AEffect) == 192);
static_assert(offsetof(VstTimeInfo, timeSigNumerator) == 64);
static_assert(offsetof(VstTimeInfo, flags) == 84);
static_assert(sizeof(VstTimeInfo) == 88);
static_assert(offsetof(VstParameterProperties, flags) == 76);
static_assert(offsetof(VstParameterProperties, minInteger) == 80);
static_assert(offsetof(VstParameterProperties, shortLabel) == 96);
static_assert(offsetof(VstParameterProperties, displayIndex) == 104);
static_assert(offsetof(VstParameterProperties, categoryLabel) == 112);
static_assert(sizeof(VstParameterProperties) == 152);
static_assert(offsetof(VstSpeakerProperties, name) == 16);
static_assert(offsetof(VstSpeakerProperties, type) == 80);
static_assert(sizeof(VstSpeakerProperties) == 112);
static_assert(offsetof(VstSpeakerArrangement, speakers) == 8);
static_assert(sizeof(VstSpeakerArrangement) == 904);
static_assert(sizeof(ERect) == 8);

} // namespace zebaudiofilterhost::vst
