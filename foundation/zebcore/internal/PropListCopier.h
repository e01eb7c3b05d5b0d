#pragma once

#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/PropListVisitor.h"

#include <list>

namespace zebcore::proplist
{

// Sets every entry that it is shown on another list, sub-lists with all that is below them.
class PropListCopier final : public PropListVisitor
{
public:
    explicit PropListCopier(PropList& target) : mTarget(target) {}

    void VisitValue(const UTF8String& key, const UTF16String& value) override { mTarget.SetValue(key, value); }
    void VisitValue(const UTF8String& key, const UTF8String& value) override { mTarget.SetValue(key, value); }
    void VisitValue(const UTF8String& key, bool value) override { mTarget.SetValue(key, value); }
    void VisitValue(const UTF8String& key, unsigned int value) override { mTarget.SetValue(key, value); }
    void VisitValue(const UTF8String& key, int value) override { mTarget.SetValue(key, value); }
    void VisitValue(const UTF8String& key, float value) override { mTarget.SetValue(key, value); }
    void VisitValue(const UTF8String& key, const std::list<float>& value) override { mTarget.SetValue(key, value); }

    void VisitSubList(const UTF8String& key, const PropList& subList) override
    {
        PropListCopier copier(mTarget.GetOrCreateSubList(key));
        subList.Visit(copier);
    }

private:
    PropList& mTarget;
};

} // namespace zebcore::proplist
