#pragma once

#include "examples/effects/support/Bases.h"
#include "examples/effects/view/BalanceIds.h"

namespace effects::balance
{

class BalanceController : public Controller
{
public:
    BalanceController() : Controller(MakeParameters()) {}

    IPlugView* PLUGIN_API createView(FIDString name) override;

    // What the view's slider does: the host hears of it and may record it.
    void BeginEdit(ParamID id);
    void PerformEdit(ParamID id, ParamValue value);
    void EndEdit(ParamID id);
};

} // namespace effects::balance
