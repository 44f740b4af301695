#include "LogGenerator/LTE/LTEClassIndex.h"

namespace pallax {

LTEClassIndex::~LTEClassIndex() {
    output().printLine("Deallocing LTEClassIndex");
}

} // namespace pallax
