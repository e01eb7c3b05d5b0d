#include "foundation/zebcore/PropListVisitor.h"

namespace zebcore::proplist
{

PropListVisitor::~PropListVisitor() = default;

void PropListVisitor::VisitValue(const UTF8String& /*key*/, const UTF16String& /*value*/)
{
}
void PropListVisitor::VisitValue(const UTF8String& /*key*/, const UTF8String& /*value*/)
{
}
void PropListVisitor::VisitValue(const UTF8String& /*key*/, bool /*value*/)
{
}
void PropListVisitor::VisitValue(const UTF8String& /*key*/, unsigned int /*value*/)
{
}
void PropListVisitor::VisitValue(const UTF8String& /*key*/, int /*value*/)
{
}
void PropListVisitor::VisitValue(const UTF8String& /*key*/, float /*value*/)
{
}
void PropListVisitor::VisitValue(const UTF8String& /*key*/, const std::list<float>& /*value*/)
{
}
void PropListVisitor::VisitSubList(const UTF8String& /*key*/, const PropList& /*subList*/)
{
}

} // namespace zebcore::proplist
