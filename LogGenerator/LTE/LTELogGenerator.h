#pragma once

#include "LogGenerator/ZORLogGenerator2.h"

namespace pallax {

/// The generator of the LTE technology: the template "LTE" over LTEClassIndex.
class LTELogGenerator final : public ZORLogGenerator2 {
public:
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment);

    explicit LTELogGenerator(const GeneratorEnvironment& environment);
    ~LTELogGenerator() override;
};

} // namespace pallax
