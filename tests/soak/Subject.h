#pragma once

#include "utility/CommonTypes.h"

#include <string>
#include <vector>

namespace soak
{

/// One effect that takes part.
struct Subject
{
    zebaudiofilterhost::UTF16String id;
    std::string name;       // with its technology
    bool withEditor = true; // whether its editor is opened
};

/// Scans the folders of the environment in this process, and returns the control and all effects whose name has the
/// text in it, in any case of its letters. Where the path of its plug-in holds one of `withoutEditor`, an effect's
/// editor stays closed. [main]
std::vector<Subject> FindSubjects(const std::string& only, const std::vector<std::string>& withoutEditor);

} // namespace soak
