#pragma once

#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/internal/XmlEvents.h"

#include <string_view>
#include <vector>

namespace zebcore::proplist
{

// Fills a list, through its virtual accessors, from the XML text of one. Whatever doesn't belong there is refused.
class PropListReader final : public xml::XmlEvents
{
public:
    explicit PropListReader(PropList& target) : mTarget(target) {}

    bool OnStartElement(const xml::XmlName& name, const std::vector<xml::XmlAttribute>& attributes) override;
    bool OnEndElement(const xml::XmlName& name) override;
    bool OnCharacters(std::u8string_view text) override;

private:
    // May take the text over.
    using SetFunction = bool (*)(PropList& list, const UTF8String& key, UTF8String& text);

    struct ValueElement
    {
        std::u8string_view mName;
        SetFunction mSet; // false: not a text of this type
    };

    static const ValueElement kValueElements[];

    bool StartRoot(const xml::XmlName& name, const std::vector<xml::XmlAttribute>& attributes);
    bool StartSubList();
    bool StartValue(std::u8string_view name);

    PropList& mTarget;
    std::vector<PropList*> mOpenLists; // the innermost one last; empty before the root element
    const ValueElement* mOpenValue = nullptr;
    UTF8String mKey;
    UTF8String mText; // of the open value
};

} // namespace zebcore::proplist
