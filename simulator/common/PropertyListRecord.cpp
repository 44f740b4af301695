#include "simulator/common/PropertyListRecord.h"

#include "plist/PropertyListCodec.h"
#include "simulator/RecordWriter.h"

#include <stdexcept>

namespace pallax {

void encodePropertyList(std::uint32_t logCode, const PropertyList& object, ListForm form,
                        ByteBuffer& out) {
    RecordWriter record(out, logCode);
    if (form == ListForm::Binary) {
        const auto bytes = serializeBinary(object);
        if (!bytes) {
            throw std::logic_error(bytes.error().reason);
        }
        record.append(*bytes);
        return;
    }
    const auto text = serializeXml(object);
    if (!text) {
        throw std::logic_error(text.error().reason);
    }
    record.append(ByteBuffer(text->begin(), text->end()));
}

} // namespace pallax
