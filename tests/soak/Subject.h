#pragma once

#include "Options.h"
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
    bool own = false;       // an example effect of this project, or the control
};

/// Scans the folders of the environment in this process, and returns the control and all effects that take part:
/// those with the text `only` of the options in their name, in any case of its letters, and none of `leftOut`, whose
/// names come out apart. Where the path of its plug-in holds one of `withoutEditorOf`, an effect's editor stays
/// closed. [main]
std::vector<Subject> FindSubjects(const Options& options, std::vector<std::string>& leftOutNames);

} // namespace soak
