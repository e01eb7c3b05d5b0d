#include "foundation/zebcore/Localizer.h"

#include "foundation/zebcore/StringConversion.h"

namespace zebcore::config
{

Localizer& Localizer::Get()
{
    // Never destroyed, so that texts can be looked up while the process exits.
    static Localizer& localizer = *new Localizer;
    return localizer;
}

UTF16String Localizer::Localize(std::string_view text) const
{
    const std::size_t equal = text.find('=');
    if (!text.starts_with("$$$/") || equal == std::string_view::npos)
        return utility::UTF16FromNarrow(text);

    const auto translation = mTranslations.find(text.substr(0, equal));
    return translation != mTranslations.end() ? translation->second
                                              : utility::UTF16FromNarrow(text.substr(equal + 1));
}

UTF16String Localizer::Localize(std::u8string_view text) const
{
    return Localize(std::string_view(utility::NarrowFromUTF8(text)));
}

void Localizer::AddTranslation(std::string_view key, const UTF16String& translation)
{
    mTranslations.insert_or_assign(std::string(key), translation);
}

void Localizer::ClearTranslations()
{
    mTranslations.clear();
}

} // namespace zebcore::config
