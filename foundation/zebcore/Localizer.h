#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <functional>
#include <map>
#include <string>
#include <string_view>

namespace zebcore::config
{

/// The texts that a user sees, in the language that the application has registered. A localisable text is UTF-8 of
/// the form "$$$/path/of/the/key=Default text".
class ZEB_EXPORT Localizer
{
public:
    /// The process-wide localizer, never destroyed. [any]
    static Localizer& Get();

    /// The translation of the key to the left of the first equal sign, or the default text to its right when there is
    /// none. A text that is no localisable text comes back as it is. [main]
    UTF16String Localize(std::string_view text) const;
    UTF16String Localize(std::u8string_view text) const;

    /// key: what stands to the left of the equal sign, "$$$/" included. Replaces an earlier translation. [main]
    void AddTranslation(std::string_view key, const UTF16String& translation);
    /// Back to the default texts. [main]
    void ClearTranslations();

private:
    std::map<std::string, UTF16String, std::less<>> mTranslations;
};

} // namespace zebcore::config
