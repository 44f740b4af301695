#pragma once

#include "LogGenerator/ZORLogGenerator2.h"

namespace pallax {

/// The generator of the GSM/UMTS technology: the template "ZOR_GSM" over ZOR_GSMClassIndex.
class ZOR_GSMLogGenerator final : public ZORLogGenerator2 {
public:
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment);

    explicit ZOR_GSMLogGenerator(const GeneratorEnvironment& environment);
    ~ZOR_GSMLogGenerator() override;
};

} // namespace pallax
