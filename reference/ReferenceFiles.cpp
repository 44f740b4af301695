#include "reference/ReferenceFiles.h"

#include "host/Recording.h"
#include "reference/Dissector.h"
#include "reference/RecordTables.h"
#include "reference/SectionsPage.h"

namespace pallax {

std::vector<ReferenceFile> referenceFiles(const Resources& resources, const std::string& program) {
    const std::vector<TechnologyReference> technologies = gatherReference(resources);
    std::vector<ReferenceFile> files{
        {"docs/man/pallax-sections.7", sectionsPage(technologies)},
        {"docs/records/README.md", recordTablesIndex(technologies)},
    };
    for (const TechnologyReference& technology : technologies) {
        files.push_back({"docs/records/" + std::string(technology.technology->commandName) + ".md",
                         recordTables(technology)});
    }
    files.push_back({"extras/wireshark/pallax.lua", dissector(technologies, program)});
    return files;
}

} // namespace pallax
