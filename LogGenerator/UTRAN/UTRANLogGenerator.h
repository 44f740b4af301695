#pragma once

#include "LogGenerator/ZORLogGenerator2.h"

#include <string>
#include <string_view>

namespace pallax {

/// The generator of the UTRAN technology: UTRANClassIndex over the first template among the
/// resources, in their sorted order, whose path contains "UTRAN" in any letter case.
///
/// Without a template it is a generator without parts (see ZORLogGenerator2), and its creation is
/// not logged.
class UTRANLogGenerator final : public ZORLogGenerator2 {
public:
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment);
    /// Whether the path, folders included, contains "UTRAN".
    static bool isTemplate(std::string_view path);

    /// With the template of that name.
    UTRANLogGenerator(const GeneratorEnvironment& environment, std::string templateName);
    /// Without a template.
    explicit UTRANLogGenerator(const GeneratorEnvironment& environment);
};

} // namespace pallax
