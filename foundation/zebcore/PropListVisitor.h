#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <list>

namespace zebcore::proplist
{

class PropList;

/// Is shown the entries of a PropList, in the order in which they were added. Override what you need; the default
/// bodies do nothing. The list must not be changed while it is visited.
class ZEB_EXPORT PropListVisitor
{
public:
    virtual ~PropListVisitor();

    virtual void VisitValue(const UTF8String& key, const UTF16String& value);
    virtual void VisitValue(const UTF8String& key, const UTF8String& value);
    virtual void VisitValue(const UTF8String& key, bool value);
    virtual void VisitValue(const UTF8String& key, unsigned int value);
    virtual void VisitValue(const UTF8String& key, int value);
    virtual void VisitValue(const UTF8String& key, float value);
    virtual void VisitValue(const UTF8String& key, const std::list<float>& value);

    /// `subList` belongs to the visited list.
    virtual void VisitSubList(const UTF8String& key, const PropList& subList);
};

} // namespace zebcore::proplist
