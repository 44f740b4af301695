#include "overview/DifferenceText.h"

#include "text/Printable.h"

#include <algorithm>
#include <string_view>

namespace pallax {

namespace {

constexpr std::string_view kArrow = " → ";
constexpr std::string_view kIndentation = "  ";

/// Where a field is shown: "1x/Receiver 0" and "Channel". A value at the top has no section, and
/// one that is an entry itself no key.
struct Place {
    std::string section;
    std::string key;
};

Place placeOf(const FieldInfo& field) {
    const std::string list = "/" + std::string(kEntryName);
    const std::string_view path = std::string_view(field.path).substr(1); // without its first "/"
    const std::size_t entry = path.find(list);
    const std::size_t last = path.rfind('/');
    if (entry != std::string_view::npos) {
        const bool isEntry = path.ends_with(list);
        return {std::string(path.substr(0, entry)),
                isEntry ? std::string() : std::string(path.substr(last + 1))};
    }
    return last == std::string_view::npos
               ? Place{"", std::string(path)}
               : Place{std::string(path.substr(0, last)), std::string(path.substr(last + 1))};
}

std::string textOf(const FieldValue& value) {
    return value.isEmpty() ? "none" : value.text();
}

std::string textOf(const Difference& difference) {
    if (difference.kind != Difference::Kind::Changed) {
        return textOf(difference.kind == Difference::Kind::New ? difference.after
                                                               : difference.before);
    }
    std::string text = textOf(difference.before);
    text.append(kArrow).append(textOf(difference.after));
    return difference.amount ? text + " (" + difference.amount->text + ")" : text;
}

/// Differences of one entry, or of one section outside lists.
struct Group {
    std::string section;
    std::string entry;
    Difference::Kind kind;
    std::vector<const Difference*> differences = {};
};

std::vector<Group> groupsOf(const std::vector<Difference>& differences) {
    std::vector<Group> groups;
    for (const Difference& difference : differences) {
        const std::string section = placeOf(*difference.field).section;
        if (groups.empty() || groups.back().section != section ||
            groups.back().entry != difference.entry || groups.back().kind != difference.kind) {
            groups.push_back({section, difference.entry, difference.kind});
        }
        groups.back().differences.push_back(&difference);
    }
    // What is gone of a list and what is new stand together.
    std::vector<std::string> sections;
    for (const Group& group : groups) {
        if (std::find(sections.begin(), sections.end(), group.section) == sections.end()) {
            sections.push_back(group.section);
        }
    }
    const auto orderOf = [&sections](const Group& group) {
        return std::find(sections.begin(), sections.end(), group.section);
    };
    std::stable_sort(groups.begin(), groups.end(), [&](const Group& one, const Group& other) {
        return orderOf(one) < orderOf(other);
    });
    return groups;
}

void appendValues(std::string& out, const Group& group, std::string_view indentation) {
    std::size_t width = 0;
    for (const Difference* difference : group.differences) {
        width = std::max(width, placeOf(*difference->field).key.size()); // ASCII
    }
    for (const Difference* difference : group.differences) {
        const std::string key = placeOf(*difference->field).key;
        out.append(indentation).append(key).append(width - key.size(), ' ').append(kIndentation);
        appendPrintable(out, textOf(*difference));
        out += '\n';
    }
}

void appendEntry(std::string& out, const Group& group) {
    const bool isGone = group.kind == Difference::Kind::Gone;
    const bool isNew = group.kind == Difference::Kind::New;
    out.append(kIndentation);
    appendPrintable(out, group.entry);
    out.append(isGone ? "  gone" : isNew ? "  new" : "");
    Group rest = group;
    std::erase_if(rest.differences, [&](const Difference* difference) {
        const bool isEntry = placeOf(*difference->field).key.empty();
        if (isEntry && !difference->field->identifies) { // the entry is this value
            out.append(kIndentation);
            appendPrintable(out, textOf(*difference));
        }
        // The other values of an entry have gone with it.
        return isEntry || isGone || (isNew && difference->field->identifies);
    });
    out += '\n';
    appendValues(out, rest, "    ");
}

} // namespace

void appendDifferencesText(std::string& out, const std::vector<Difference>& differences) {
    std::string section = "\n"; // none has this name
    for (const Group& group : groupsOf(differences)) {
        if (group.section != section) {
            section = group.section;
            out += "\n";
            out += section.empty() ? "" : section + "\n";
        }
        if (group.entry.empty()) {
            appendValues(out, group, section.empty() ? "" : kIndentation);
        } else {
            appendEntry(out, group);
        }
    }
}

} // namespace pallax
