#include "reference/ReferenceFiles.h"

#include "host/Recording.h"
#include "reference/Dissector.h"
#include "reference/RecordTables.h"
#include "reference/SectionsPage.h"

#include <fstream>
#include <iterator>
#include <stdexcept>

namespace pallax {

std::string dissectorProgram(const std::string& tree) {
    std::string program;
    for (const char* name : {"numbers", "computations", "items", "property_lists", "binary_lists",
                             "xml_lists", "text_lists", "list_sections", "records"}) {
        const std::string path = tree + "/reference/dissector/" + name + ".lua";
        std::ifstream file(path, std::ios::binary);
        if (!file) {
            throw std::runtime_error(path + " cannot be read");
        }
        program.append(program.empty() ? "" : "\n");
        program.append(std::istreambuf_iterator<char>(file), {});
    }
    return program;
}

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
