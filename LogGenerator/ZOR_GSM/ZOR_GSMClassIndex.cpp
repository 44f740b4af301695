#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"

namespace pallax {

ZOR_GSMClassIndex::~ZOR_GSMClassIndex() {
    output().printLine("Deallocing ZOR_GSMClassIndex");
}

} // namespace pallax
