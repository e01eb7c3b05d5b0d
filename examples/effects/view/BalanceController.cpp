#include "examples/effects/view/BalanceController.h"

#include "examples/effects/view/BalanceView.h"

namespace effects::balance
{

IPlugView* PLUGIN_API BalanceController::createView(FIDString name)
{
    return FIDStringsEqual(name, ViewType::kEditor) ? new BalanceView(this) : nullptr;
}

void BalanceController::BeginEdit(ParamID id)
{
    if (mHandler != nullptr)
        mHandler->beginEdit(id);
}

void BalanceController::PerformEdit(ParamID id, ParamValue value)
{
    setParamNormalized(id, value);
    if (mHandler != nullptr)
        mHandler->performEdit(id, value);
}

void BalanceController::EndEdit(ParamID id)
{
    if (mHandler != nullptr)
        mHandler->endEdit(id);
}

} // namespace effects::balance
