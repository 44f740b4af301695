#pragma once

#include "plist/PropertyListCodec.h"
#include "tests/doubles/RecordBuilder.h"

#include <gtest/gtest.h>

#include <string_view>

namespace pallax::doubles {

/// A log record with a property list after its header, in the binary form.
inline Record propertyListRecord(LogCode logCode, const PropertyList& object) {
    const auto bytes = serializeBinary(object);
    EXPECT_TRUE(bytes) << object.description();
    Record record(logCode);
    return bytes ? record.append(Bytes(*bytes)) : record;
}

/// A log record with a text after its header: a property list in the XML or the text form.
inline Record textRecord(LogCode logCode, std::string_view text) {
    return Record(logCode).append(ByteBuffer(text.begin(), text.end()));
}

} // namespace pallax::doubles
