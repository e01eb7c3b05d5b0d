#include "host/src/VST3/src/IndexWalk.h"
#include "host/src/VST3/src/ScopeExit.h"
#include "host/src/VST3/src/VST3AudioFilter.h"

#include <memory>
#include <utility>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::Vst::ParameterInfo;

namespace
{

using Parameters = Published<ParameterTable>::Reader;

// What decides about one parameter of the controller.
struct ListedParameter
{
    std::uint32_t id;
    int32 flags;
    Steinberg::Vst::UnitID unit;

    bool IsProgramChangeOfRoot() const
    {
        return (flags & ParameterInfo::kIsProgramChange) != 0 && unit == Steinberg::Vst::kRootUnitId;
    }
    bool IsForApplication() const
    {
        constexpr int32 kHidden =
            ParameterInfo::kIsReadOnly | ParameterInfo::kIsProgramChange | ParameterInfo::kIsBypass;
        return (flags & kHidden) == 0;
    }
};

// A parameter that the controller fails to describe counts as one with the ID 0 and without flags. A count beyond all
// bounds is a lie: the list then ends with the last parameter that is described.
std::vector<ListedParameter> ListParameters(Steinberg::Vst::IEditController& controller, int count)
{
    std::vector<ListedParameter> parameters;
    std::size_t described = 0;
    for (int index = 0; index < std::min(count, kMaxListLength); ++index)
    {
        ParameterInfo info = {};
        const Steinberg::tresult result = controller.getParameterInfo(index, info);
        parameters.push_back({info.id, info.flags, info.unitId});
        // Some describe the parameter and report a failure all the same.
        if (result == Steinberg::kResultOk || info.id != 0 || info.title[0] != 0)
            described = parameters.size();
    }
    if (count > kMaxListLength)
        parameters.resize(described);
    return parameters;
}

bool IsIndexOf(int index, const ParameterTable& table)
{
    return index >= 0 && static_cast<std::size_t>(index) < table.mParameterInfos.size();
}

} // namespace

// Runs on whatever thread the plug-in asks from, while others read the parameters: the new table takes the place of
// the old one as a whole.
void VST3AudioFilter::BuildParameterInfos()
{
    // Of several threads that ask at once the first works for all, and begins anew when another has asked meanwhile:
    // two rebuilds at the same time could publish parts of different lists. Bounded, for a controller that asks again
    // whenever it is asked.
    if (!mController || mRebuildsAsked.fetch_add(1) != 0)
        return;
    constexpr int kMaxRounds = 4;
    bool settled = false;
    const ScopeExit giveUp(
        [&]
        {
            if (!settled)
                mRebuildsAsked = 0;
        });
    for (int round = 0; round < kMaxRounds && !settled; ++round)
    {
        unsigned int asked = mRebuildsAsked;
        RebuildParameterInfos();
        settled = mRebuildsAsked.compare_exchange_strong(asked, 0);
    }
}

void VST3AudioFilter::RebuildParameterInfos()
{
    const int32 count = mController->getParameterCount();
    ParameterTable table;
    const std::vector<ListedParameter> parameters = ListParameters(*mController, count);
    for (std::size_t index = 0; index < parameters.size(); ++index)
    {
        const ListedParameter& parameter = parameters[index];
        if (parameter.IsProgramChangeOfRoot())
            TakeProgramChange(parameter.id, static_cast<int>(index));
        else if (parameter.IsForApplication())
        {
            boost::intrusive_ptr<VST3ParameterInfo> info(
                new VST3ParameterInfo(mController.Get(), static_cast<int>(index)));
            // The first keeps an ID that comes again: parameters that can't be read all have the ID 0.
            table.mParameterIndexByID.try_emplace(info->GetParameterID(), table.mParameterInfos.size());
            table.mParameterInfos.push_back(std::move(info));
        }
        table.mParameterIDs.push_back(parameter.id);
    }
    mInputTransfer.SetParameterIDs(table.mParameterIDs);
    mOutputTransfer.SetParameterIDs(table.mParameterIDs);
    if (count >= 0)
        OfferQueues(static_cast<int>(table.mParameterIDs.size()));
    mParameters.Publish(std::move(table));
}

// The first one that is found stays, whatever later rebuilds see.
void VST3AudioFilter::TakeProgramChange(std::uint32_t id, int index)
{
    if (mProgramChangeID.load(std::memory_order_relaxed) != kNoParameterID)
        return;
    mProgramChangeIndex.store(index, std::memory_order_relaxed);
    mProgramChangeID.store(id, std::memory_order_release); // whoever sees the ID sees its index
}

// A rebuild does not touch the parameter changes, which a block may be using: it makes queues for the new list, and
// the next block swaps them in.
void VST3AudioFilter::OfferQueues(int count)
{
    auto offer = std::make_unique<QueueSet>();
    offer->mInput = ParameterChanges::MakeQueues(count);
    offer->mOutput = ParameterChanges::MakeQueues(count);
    // Released to the thread that takes it; an older one that nobody has taken comes back.
    const std::unique_ptr<QueueSet> older(mOfferedQueues.exchange(offer.release(), std::memory_order_acq_rel));
}

void VST3AudioFilter::FreeSpentQueues()
{
    QueueSet* spent = mSpentQueues.exchange(nullptr, std::memory_order_acquire); // what the taker swapped out
    while (spent != nullptr)
        std::unique_ptr<QueueSet>(std::exchange(spent, spent->mNext));
}

int VST3AudioFilter::GetParameterCount() const
{
    return static_cast<int>(Parameters(mParameters)->mParameterInfos.size());
}

float VST3AudioFilter::GetParameter(int index) const
{
    std::uint32_t id = 0;
    if (!mController || !FindParameterID(index, id))
        return 0.0F;
    return static_cast<float>(mController->getParamNormalized(id));
}

boost::intrusive_ptr<AudioFilterParameterInfo> VST3AudioFilter::GetParameterInfo(int index) const
{
    return FindParameterInfo(index);
}

UTF16String VST3AudioFilter::GetParameterString(int index) const
{
    const auto info = FindParameterInfo(index);
    if (!mController || !info)
        return {};
    return info->GetParameterString(static_cast<float>(mController->getParamNormalized(info->GetParameterID())));
}

// Null for an index out of range.
boost::intrusive_ptr<VST3ParameterInfo> VST3AudioFilter::FindParameterInfo(int index) const
{
    const Parameters parameters(mParameters);
    if (!IsIndexOf(index, *parameters))
        return nullptr;
    return parameters->mParameterInfos[static_cast<std::size_t>(index)];
}

// Negative for a parameter that the application does not see.
int VST3AudioFilter::FindParameterIndex(Steinberg::Vst::ParamID id) const
{
    const Parameters parameters(mParameters);
    const auto found = parameters->mParameterIndexByID.find(id);
    return found == parameters->mParameterIndexByID.end() ? -1 : static_cast<int>(found->second);
}

void VST3AudioFilter::OnUITimerTick()
{
    AudioFilter::OnUITimerTick();
    mParameters.FreeRetired();
    mInputTransfer.FreeRetired();
    mOutputTransfer.FreeRetired();
    FreeSpentQueues();
    if (mVendorEffect && mVendorEffect->IsDirty())
        BumpParameterDirtyCount();
    if (mController)
        PassOutputToController();
}

// What the processor wrote. No signal of the application fires for it.
void VST3AudioFilter::PassOutputToController()
{
    if (!mOutputTransfer.HasChanges())
        return;
    const Parameters parameters(mParameters);
    for (const std::uint32_t id : parameters->mParameterIDs)
    {
        double value = 0.0;
        int32 offset = 0;
        while (mOutputTransfer.GetNextChange(id, value, offset))
            mController->setParamNormalized(id, value);
    }
}

} // namespace zebaudiofilterhost::vst3
