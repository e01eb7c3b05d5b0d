#include "tests/plugins/support/HostAccess.h"

#include <atomic>

namespace fixture
{

namespace
{

std::atomic<IComponentHandler*> sHandler{nullptr};
std::atomic<FUnknown*> sContext{nullptr};
std::atomic<FixtureView*> sView{nullptr};
std::atomic<RunLoopUser*> sRunLoopUser{nullptr};

} // namespace

IComponentHandler* Handler()
{
    return sHandler;
}

void SetHandler(IComponentHandler* handler)
{
    sHandler = handler;
}

FUnknown* HostContext()
{
    return sContext;
}

void SetHostContext(FUnknown* context)
{
    sContext = context;
}

FixtureView* NewestView()
{
    return sView;
}

void SetNewestView(FixtureView* view)
{
    sView = view;
}

RunLoopUser* NewestRunLoopUser()
{
    return sRunLoopUser;
}

void SetNewestRunLoopUser(RunLoopUser* user)
{
    sRunLoopUser = user;
}

} // namespace fixture
