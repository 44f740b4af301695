#include "plist/ScalarPlaces.h"

#include "plist/Refusal.h"

namespace pallax {

namespace {

ScalarScan scan(Bytes bytes, const ScalarVisitor& visitor) {
    switch (formOf(bytes)) {
    case PropertyListForm::Xml:
        return scanXmlScalars(bytes, visitor);
    case PropertyListForm::Binary:
        return scanBinaryScalars(bytes, visitor);
    case PropertyListForm::Text:
        break;
    }
    return scanTextScalars(bytes, visitor);
}

} // namespace

Result<ScalarScan, CodecError> scanScalars(Bytes bytes, const ScalarVisitor& visitor) {
    // The scanners rely on the checks of the readers.
    if (const auto parsed = parsePropertyList(bytes); !parsed) {
        return parsed.error();
    }
    return refusedOr<ScalarScan>(
        [&]() -> Result<ScalarScan, CodecError> { return scan(bytes, visitor); });
}

} // namespace pallax
