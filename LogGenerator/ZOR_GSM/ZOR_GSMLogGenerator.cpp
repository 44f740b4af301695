#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"

#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"
#include "platform/SystemLog.h"

namespace pallax {

ZOR_GSMLogGenerator::ZOR_GSMLogGenerator(const GeneratorEnvironment& environment)
    : ZORLogGenerator2(environment, [&environment] {
          systemLog(LogPriority::Error, "Creating ZOR_GSMLogGenerator object");
          return Parts{"ZOR_GSM", std::make_shared<ZOR_GSMClassIndex>(environment.standardOutput)};
      }()) {}

ZOR_GSMLogGenerator::~ZOR_GSMLogGenerator() {
    systemLog(LogPriority::Warning, "ZOR_GSMLogGenerator is destructed %p",
              static_cast<const void*>(this));
}

std::unique_ptr<LogGenerator>
ZOR_GSMLogGenerator::generator(const GeneratorEnvironment& environment) {
    return std::make_unique<ZOR_GSMLogGenerator>(environment);
}

} // namespace pallax
