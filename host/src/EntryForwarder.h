#pragma once

#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/PropListVisitor.h"
#include "utility/CommonTypes.h"

#include <list>
#include <optional>

namespace zebaudiofilterhost
{

// Stands in for a list that is written once from top to bottom, and shows each entry to a visitor instead of keeping
// it. A sub-list is shown when the next entry begins: it must be complete by then. No key may come twice.
class EntryForwarder final : public PropList
{
public:
    explicit EntryForwarder(zebcore::proplist::PropListVisitor& visitor) : mVisitor(visitor) {}

    using PropList::SetValue;
    void SetValue(const UTF8String& key, const UTF16String& value) override { Forward(key, value); }
    void SetValue(const UTF8String& key, const UTF8String& value) override { Forward(key, value); }
    void SetValue(const UTF8String& key, const bool& value) override { Forward(key, value); }
    void SetValue(const UTF8String& key, const unsigned int& value) override { Forward(key, value); }
    void SetValue(const UTF8String& key, const int& value) override { Forward(key, value); }
    void SetValue(const UTF8String& key, const float& value) override { Forward(key, value); }
    void SetValue(const UTF8String& key, const std::list<float>& value) override { Forward(key, value); }

    PropList& GetOrCreateSubList(const UTF8String& key) override
    {
        Finish();
        mOpenKey = key;
        return mOpenSubList;
    }

    // Shows the last sub-list.
    void Finish()
    {
        if (mOpenKey)
        {
            mVisitor.VisitSubList(*mOpenKey, mOpenSubList);
        }
        mOpenKey.reset();
        mOpenSubList.Clear();
    }

private:
    template <typename T>
    void Forward(const UTF8String& key, const T& value)
    {
        Finish();
        mVisitor.VisitValue(key, value);
    }

    zebcore::proplist::PropListVisitor& mVisitor;
    std::optional<UTF8String> mOpenKey;
    PropList mOpenSubList; // of the open key
};

} // namespace zebaudiofilterhost
