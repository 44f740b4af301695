#include "fields/Reference.h"

#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/LTE/LTEClassIndex.h"
#include "LogGenerator/UTRAN/UTRANClassIndex.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"
#include "fields/IfxSections.h"
#include "platform/RecordedTechnology.h"

#include <algorithm>
#include <array>
#include <map>
#include <set>
#include <stdexcept>
#include <utility>

namespace pallax {

namespace {

/// Discards the notices that class indexes print on destruction.
class NoOutput final : public StandardOutput {
public:
    void printLine(std::string_view /*line*/) override {}
};

DictionaryRef templateNamed(const Resources& resources, std::string_view name) {
    const auto loaded = resources.propertyList(name);
    DictionaryRef entries = loaded ? loaded->dictionary() : nullptr;
    if (entries == nullptr) {
        throw std::runtime_error("the template " + std::string(name) + " cannot be read");
    }
    return entries;
}

/// Appends the sections of the records, at any depth, in the order of the template.
void appendSections(const Dictionary& entries, const ClassIndex& index, const std::string& around,
                    std::vector<SectionReference>& sections) {
    for (const Dictionary::Entry& entry : entries) {
        const std::string path = around + "/" + entry.key.string();
        if (const auto* numbered = index.recordOf(entry.key.view())) {
            const RecordLayout& layout = numbered->record->layout();
            SectionReference& section = sections.emplace_back();
            section.name = layout.section;
            section.path = path;
            section.isList = layout.kind == SectionKind::List;
            section.codes = describe(layout, numbered->firstRow);
            section.meaning = layout.meaning;
        } else if (const DictionaryRef inner = entry.value.dictionary()) {
            appendSections(*inner, index, path, sections);
        }
    }
}

template <class Index>
std::vector<SectionReference> recordSections(const Resources& resources,
                                             std::string_view templateName) {
    NoOutput output;
    const Index index(output);
    std::vector<SectionReference> sections;
    appendSections(*templateNamed(resources, templateName), index, "", sections);
    return sections;
}

std::vector<SectionReference> gsmSections(const Resources& resources) {
    return recordSections<ZOR_GSMClassIndex>(resources, "ZOR_GSM");
}

std::vector<SectionReference> lteSections(const Resources& resources) {
    return recordSections<LTEClassIndex>(resources, "LTE");
}

std::vector<SectionReference> utranSections(const Resources& resources) {
    return recordSections<UTRANClassIndex>(resources, "UTRAN");
}

/// Maps a lookup name to the keys of one section that show it.
using Places = std::multimap<std::string, std::string>;

/// The items that the section shows, with its display keys.
template <class Described>
std::vector<Described> shownIn(const Places& places, const std::vector<Described>& all) {
    std::vector<Described> shown;
    for (const Described& each : all) {
        const auto [first, last] = places.equal_range(each.key);
        for (auto place = first; place != last; ++place) {
            shown.push_back(each);
            shown.back().key = place->second;
        }
    }
    return shown;
}

/// The part of a code that the section shows, if any.
std::optional<CodeDescription> shownIn(const Places& places, const CodeDescription& code) {
    CodeDescription shown = code;
    shown.fields = shownIn(places, code.fields);
    shown.lists = shownIn(places, code.lists);
    bool any = !shown.fields.empty() || !shown.lists.empty();
    for (SubpacketDescription& subpacket : shown.subpackets) {
        subpacket.fields = shownIn(places, subpacket.fields);
        subpacket.lists = shownIn(places, subpacket.lists);
        any = any || !subpacket.fields.empty() || !subpacket.lists.empty();
    }
    return any ? std::optional(std::move(shown)) : std::nullopt;
}

/// The sentence for a section of the template, which contains only section names.
std::string_view cdmaSectionMeaning(std::string_view section) {
    static constexpr auto kMeanings = std::to_array<std::pair<std::string_view, std::string_view>>({
        {"System Identity", "Which 1x system serves the phone."},
        {"1x", "State and radio of the 1x device."},
        {"1x / Receiver 0", "The first receiver of the 1x device."},
        {"1x / Receiver 1", "The second receiver of the 1x device, shown while in Traffic."},
        {"EV-DO", "State, session and radio of EV-DO."},
        {"Data Rates", "What the EV-DO links carry."},
    });
    const auto* found = std::find_if(kMeanings.begin(), kMeanings.end(),
                                     [section](const auto& each) { return each.first == section; });
    return found != kMeanings.end() ? found->second : std::string_view();
}

/// Appends a section for each dictionary of the template that shows a lookup name.
void appendPlaces(const Dictionary& entries, const std::string& name, const std::string& path,
                  const std::vector<CodeDescription>& codes,
                  std::vector<SectionReference>& sections) {
    Places places;
    for (const Dictionary::Entry& entry : entries) {
        if (const auto lookupName = entry.value.string()) {
            places.emplace(*lookupName, entry.key.string());
        }
    }
    if (!places.empty()) {
        SectionReference section{name, path};
        section.meaning = cdmaSectionMeaning(name);
        for (const CodeDescription& code : codes) {
            if (auto shown = shownIn(places, code)) {
                section.codes.push_back(std::move(*shown));
            }
        }
        sections.push_back(std::move(section));
    }
    for (const Dictionary::Entry& entry : entries) {
        if (const DictionaryRef inner = entry.value.dictionary()) {
            std::string innerName = name;
            innerName.append(name.empty() ? "" : " / ").append(entry.key.string());
            appendPlaces(*inner, innerName, path + "/" + entry.key.string(), codes, sections);
        }
    }
}

std::vector<SectionReference> cdmaSections(const Resources& resources) {
    std::vector<SectionReference> sections;
    std::vector<CodeDescription> codes;
    FieldId row = 0;
    for (const CodeLayout* layout : C2KLogGenerator::layouts()) {
        codes.push_back(describe(*layout, row));
        row += static_cast<FieldId>(rowCount(*layout));
    }
    appendPlaces(*templateNamed(resources, "C2KTemplate"), "", "", codes, sections);
    return sections;
}

struct Source {
    std::string_view commandName;
    std::string_view title;
    std::vector<SectionReference> (*sections)(const Resources& resources);
};

constexpr auto kSources = std::to_array<Source>({
    {"ifx", "IFX", ifxSections},
    {"gsm", "GSM/UMTS", gsmSections},
    {"cdma", "CDMA", cdmaSections},
    {"lte", "LTE", lteSections},
    {"utran", "UTRAN", utranSections},
});

const Source& sourceOf(std::string_view commandName) {
    return *std::find_if(kSources.begin(), kSources.end(), [commandName](const Source& source) {
        return source.commandName == commandName;
    });
}

std::string_view sentenceOf(const std::vector<FieldDescription>& fields,
                            const std::vector<ListDescription>& lists, std::string_view key) {
    for (const FieldDescription& field : fields) {
        if (field.key == key && !field.meaning.empty()) {
            return field.meaning;
        }
    }
    for (const ListDescription& list : lists) {
        const bool isList = list.key == key && !list.meaning.empty();
        const std::string_view sentence =
            isList ? list.meaning : sentenceOf(list.fields, list.lists, key);
        if (!sentence.empty()) {
            return sentence;
        }
    }
    return {};
}

/// The sentence of the section's first row with that key and a sentence.
std::string_view sentenceOf(const SectionReference& section, std::string_view key) {
    if (key.empty()) {
        return section.meaning;
    }
    for (const ObjectKey& each : section.objectKeys) {
        if (each.name == key) {
            return each.meaning;
        }
    }
    for (const CodeDescription& code : section.codes) {
        std::string_view sentence = sentenceOf(code.fields, code.lists, key);
        for (const SubpacketDescription& subpacket : code.subpackets) {
            if (sentence.empty()) {
                sentence = sentenceOf(subpacket.fields, subpacket.lists, key);
            }
        }
        if (!sentence.empty()) {
            return sentence;
        }
    }
    return {};
}

std::string_view nameIn(const std::vector<SectionReference>& sections, LogCode logCode) {
    for (const SectionReference& section : sections) {
        for (const CodeDescription& code : section.codes) {
            if (code.logCode == logCode && !code.name.empty()) {
                return code.name;
            }
        }
    }
    return {};
}

} // namespace

std::vector<TechnologyReference> gatherReference(const Resources& resources) {
    std::vector<TechnologyReference> technologies;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        technologies.push_back(gatherReference(technology, resources));
    }
    return technologies;
}

TechnologyReference gatherReference(const RecordedTechnology& technology,
                                    const Resources& resources) {
    const Source& source = sourceOf(technology.commandName);
    return {&technology, source.title, source.sections(resources)};
}

std::string_view TechnologyReference::meaningOf(std::string_view section,
                                                std::string_view key) const {
    const auto found =
        std::find_if(sections.begin(), sections.end(),
                     [section](const SectionReference& each) { return each.name == section; });
    return found != sections.end() ? sentenceOf(*found, key) : std::string_view();
}

std::string_view TechnologyReference::nameOf(LogCode logCode) const {
    return nameIn(sections, logCode);
}

std::vector<LogCode> codesOf(const TechnologyReference& technology) {
    std::set<LogCode> codes;
    for (const SectionReference& section : technology.sections) {
        for (const CodeDescription& code : section.codes) {
            codes.insert(code.logCode);
        }
    }
    return {codes.begin(), codes.end()};
}

} // namespace pallax
