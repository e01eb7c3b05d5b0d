#pragma once

#include "catalogue/Catalogue.h"

#include <optional>
#include <string>
#include <vector>

namespace zebhost
{

// Finds the one filter that a FILTER operand means: a filter ID, a name that fits one entry of the catalogue, what
// its plug-in's file is called, a plug-in's path, or path#name of the effect. A plug-in that is not in the catalogue
// is scanned into memory, and not saved.
class FilterSelector
{
public:
    explicit FilterSelector(const Catalogue& catalogue);

    // Never null: throws a Failure that tells the candidates when there are several, and what to do when there is
    // none. Blocked plug-ins are refused.
    Catalogue::Descriptor Select(const std::string& text) const;

    // What a PLUGIN operand means: a path, or a plug-in or filter of the catalogue as above. Never empty, and one,
    // but for an Audio Unit bundle with several units. Blocked ones are not refused.
    std::vector<zebaudiofilterhost::PluginLocator> SelectPlugins(const std::string& text) const;

private:
    Catalogue::Descriptor FindByPath(const std::string& path, const std::string& className) const;
    Catalogue::Descriptor FindByName(const std::string& name) const;
    // The plug-in of the catalogue that is called so, unless a path is meant. Throws a Failure if there are several.
    std::optional<zebaudiofilterhost::PluginLocator> FindCalled(const std::string& text) const;
    std::vector<Catalogue::Descriptor>
    EffectsOf(const std::vector<zebaudiofilterhost::PluginLocator>& locators) const;
    void Scan(const std::vector<zebaudiofilterhost::PluginLocator>& locators) const;
    void ScanOne(const zebaudiofilterhost::PluginLocator& locator) const;

    const Catalogue& mCatalogue;
};

} // namespace zebhost
