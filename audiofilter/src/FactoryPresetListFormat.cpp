#include "audiofilter/PresetList.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/StringStreams.h"
#include "foundation/zebcore/Trace.h"

#include <algorithm>
#include <iomanip>
#include <vector>

namespace zebaudiofilterhost
{

namespace
{

using zebcore::utility::oUTF8StringStream;

constexpr int kValueDigits = 8;

// What a preset must have to be printed with its values.
struct Reference
{
    float version;
    std::size_t paramCount;
};

struct Row
{
    UTF16String name;
    boost::intrusive_ptr<PresetData> preset; // Null if the name does not lead back to its section
    std::list<float> params;

    bool HoldsParams() const { return preset && preset->GetPresetType() == PresetData::kPresetType_Params; }
};

std::vector<Row> CollectRows(const PresetList& list)
{
    std::set<UTF16String> names;
    list.GetPresetNames(names);
    std::vector<Row> rows;
    for (const UTF16String& name : names)
    {
        rows.push_back(Row{name, list.GetPreset(name), {}});
        if (rows.back().HoldsParams())
            rows.back().preset->GetParamList(rows.back().params);
    }
    return rows;
}

void WriteHead(oUTF8StringStream& text, std::size_t presetCount, std::size_t paramCount)
{
    text << "const int kNumFactoryPresets = " << presetCount << ";\n"
         << "const int kNumFactoryParams = " << paramCount << ";\n"
         << "\n"
         << "struct PresetData\n"
         << "{\n"
         << "\tchar*\t\tName;\n"
         << "\tfloat\t\tParams[kNumFactoryParams];\n"
         << "};\n"
         << "\n"
         << "PresetData sPresets[kNumFactoryPresets] = {\n";
}

void WriteRow(oUTF8StringStream& text, const Row& row, const Reference& reference, bool first)
{
    text << (first ? "\t  { \"" : "\t, { \"") << zebcore::utility::UTF16to8(row.name) << "\", { ";
    if (row.HoldsParams() && row.preset->GetVersion() == reference.version &&
        row.params.size() == reference.paramCount)
    {
        const char* separator = "  ";
        for (const float value : row.params)
        {
            text << separator << value << "f";
            separator = ", ";
        }
        text << "}}\n";
    }
    else
        text << " ***placeholder***}}\n";
}

} // namespace

void FormatFactoryPresetList(const boost::intrusive_ptr<PresetList>& list)
{
    if (!list)
        return;
    const std::vector<Row> rows = CollectRows(*list);
    const auto model = std::find_if(rows.begin(), rows.end(), [](const Row& row) { return row.HoldsParams(); });
    if (model == rows.end())
        return;
    const Reference reference{model->preset->GetVersion(), model->params.size()};

    oUTF8StringStream text;
    text << std::showpoint << std::setprecision(kValueDigits);
    WriteHead(text, rows.size(), reference.paramCount);
    for (const Row& row : rows)
        WriteRow(text, row, reference, &row == &rows.front());
    text << "};\n";
    UTF8String whole = text.str();
    std::erase(whole, u8'\0'); // A name may have one, which would end the print-out
    zebcore::debug::DebugTrace(reinterpret_cast<const unsigned char*>(whole.c_str()));
}

} // namespace zebaudiofilterhost
