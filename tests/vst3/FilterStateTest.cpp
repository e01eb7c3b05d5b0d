// The chunk in which a VST 3 filter keeps its plug-in's state.

#include "tests/vst3/FakePlugin.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace fakeplugin;
using testing::ElementsAre;
using zebaudiofilterhost::PresetData;
using zebaudiofilterhost::PropList;

namespace
{

using Chunk = std::vector<unsigned char>;

Chunk MakeChunk(std::uint64_t componentSize, std::uint64_t controllerSize, const std::string& content)
{
    Chunk chunk;
    for (const std::uint64_t size : {componentSize, controllerSize})
        for (int byte = 0; byte < 8; ++byte)
            chunk.push_back(static_cast<unsigned char>(size >> (8 * byte)));
    chunk.insert(chunk.end(), content.begin(), content.end());
    return chunk;
}

class FilterState : public testing::Test
{
protected:
    FilterState() : preset(list) {}

    Chunk SavedChunk()
    {
        Chunk chunk;
        preset.GetChunkData(chunk);
        return chunk;
    }

    FakePlugin plugin;
    PropList list;
    PresetData preset;
};

} // namespace

TEST_F(FilterState, ChunkHoldsBothStatesBehindTheirSizes)
{
    plugin.state = "0123456789";
    plugin.controllerState = "abc";
    const auto filter = plugin.MakeFilter();
    EXPECT_TRUE(filter->DoPresetsUseChunkData());
    EXPECT_TRUE(filter->SaveChunkData(preset));
    EXPECT_EQ(SavedChunk(), MakeChunk(10, 3, "0123456789abc"));
    EXPECT_EQ(preset.GetPresetType(), PresetData::kPresetType_Chunk);
    EXPECT_EQ(preset.GetVersion(), 1.0F);
}

TEST_F(FilterState, StatesThatCantBeHadAreEmpty)
{
    plugin.state = "0123456789";
    plugin.controllerState = "abc";
    plugin.getControllerStateResult = kResultFalse;
    const auto filter = plugin.MakeFilter();
    EXPECT_TRUE(filter->SaveChunkData(preset));
    EXPECT_EQ(SavedChunk(), MakeChunk(10, 0, "0123456789"));

    plugin.getStateResult = kNotImplemented;
    plugin.getControllerStateResult = kResultOk;
    EXPECT_TRUE(filter->SaveChunkData(preset));
    EXPECT_EQ(SavedChunk(), MakeChunk(0, 3, "abc"));

    preset.Clear();
    plugin.controllerState.clear();
    EXPECT_TRUE(filter->SaveChunkData(preset));
    EXPECT_TRUE(preset.IsEmpty());
}

TEST_F(FilterState, LoadCallsInOrder)
{
    const auto filter = plugin.MakeFilter();
    plugin.ClearCalls();
    const Chunk chunk = MakeChunk(4, 3, "COMPctl");
    preset.SetChunkData(chunk.data(), chunk.size());
    EXPECT_TRUE(filter->LoadChunkData(preset));
    EXPECT_THAT(plugin.Calls(), ElementsAre("component.setState COMP", "controller.setComponentState COMP",
                                            "controller.setState ctl"));
}

TEST_F(FilterState, OlderParameterChangesDoNotReachThePluginBehindIt)
{
    plugin.parameters = {{1}};
    const auto filter = plugin.MakeFilter();
    std::vector<double> values;
    plugin.process = [&](ProcessData& data)
    {
        for (int index = 0; index < data.inputParameterChanges->getParameterCount(); ++index)
        {
            int32 offset = 0;
            data.inputParameterChanges->getParameterData(index)->getPoint(0, offset, values.emplace_back());
        }
        return kResultOk;
    };
    filter->SetParameter(0, 0.75F);
    Chunk chunk = MakeChunk(10, 0, "short");
    preset.SetChunkData(chunk.data(), chunk.size());
    filter->LoadChunkData(preset);
    filter->FlushMessageQueue();
    EXPECT_THAT(values, ElementsAre(0.75)) << "nothing was loaded";

    filter->SetParameter(0, 0.5F);
    chunk = MakeChunk(4, 0, "COMP");
    preset.SetChunkData(chunk.data(), chunk.size());
    // A plug-in may set parameters while it takes its state.
    plugin.called = [&](const std::string& call)
    {
        if (call.starts_with("controller.setComponentState"))
            filter->performEdit(1, 0.25);
    };
    filter->LoadChunkData(preset);
    filter->FlushMessageQueue();
    EXPECT_THAT(values, ElementsAre(0.75, 0.25));
}

TEST_F(FilterState, EmptyComponentStateIsLoadedAndEmptyControllerStateIsNot)
{
    const auto filter = plugin.MakeFilter();
    plugin.ClearCalls();
    const Chunk chunk = MakeChunk(0, 0, "");
    preset.SetChunkData(chunk.data(), chunk.size());
    EXPECT_TRUE(filter->LoadChunkData(preset));
    EXPECT_THAT(plugin.Calls(), ElementsAre("component.setState ", "controller.setComponentState "));
}

TEST_F(FilterState, OfAChunkThatLiesTheStatesThatAreThereComeBack)
{
    const auto filter = plugin.MakeFilter();
    const std::uint64_t huge = ~std::uint64_t(0);
    const std::vector<std::string> none;
    const auto both = [](const std::string& state)
    {
        return std::vector{"component.setState " + state, "controller.setComponentState " + state};
    };
    for (const auto& [chunk, calls] : std::initializer_list<std::pair<Chunk, std::vector<std::string>>>{
             {MakeChunk(10, 0, "0123"), none},
             {MakeChunk(10, 5, "0123"), none},
             {MakeChunk(huge, 0, "0123"), none},
             {Chunk(1, 7), none},
             {MakeChunk(2, 3, "0123"), both("01")},
             {MakeChunk(4, huge, "0123"), both("0123")},
             {MakeChunk(0x100000004, 0, "0123"), both("0123")},
             {Chunk(15, 0), both("")},
             {MakeChunk(0x7fffffff, 4, "0123"), none},
             {MakeChunk(0x80000000, 4, "0123"), {"controller.setState 0123"}}})
    {
        plugin.ClearCalls();
        preset.SetChunkData(chunk.data(), chunk.size());
        EXPECT_TRUE(filter->LoadChunkData(preset));
        EXPECT_EQ(plugin.Calls(), calls) << chunk.size();
    }
}

TEST_F(FilterState, PresetWithoutChunkIsRefused)
{
    EXPECT_FALSE(plugin.MakeFilter()->LoadChunkData(preset));
    plugin.createsComponent = false;
    const auto filter = plugin.MakeFilter();
    EXPECT_FALSE(filter->SaveChunkData(preset));
    const Chunk chunk = MakeChunk(1, 0, "x");
    preset.SetChunkData(chunk.data(), chunk.size());
    EXPECT_FALSE(filter->LoadChunkData(preset));
}

TEST_F(FilterState, BigStatesSurvive)
{
    std::string big(8 << 20, '\0');
    for (std::size_t index = 0; index < big.size(); ++index)
        big[index] = static_cast<char>(index * 7 >> 3);
    plugin.state = big;
    const auto filter = plugin.MakeFilter();
    filter->SaveSettings(preset);
    plugin.state.clear();
    EXPECT_TRUE(filter->LoadSettings(preset));
    EXPECT_TRUE(plugin.state == big);
}
