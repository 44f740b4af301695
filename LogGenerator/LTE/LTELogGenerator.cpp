#include "LogGenerator/LTE/LTELogGenerator.h"

#include "LogGenerator/LTE/LTEClassIndex.h"
#include "platform/SystemLog.h"

namespace pallax {

LTELogGenerator::LTELogGenerator(const GeneratorEnvironment& environment)
    : ZORLogGenerator2(environment, [&environment] {
          systemLog(LogPriority::Error, "Creating LTELogGenerator object");
          return Parts{"LTE", std::make_shared<LTEClassIndex>(environment.standardOutput)};
      }()) {}

LTELogGenerator::~LTELogGenerator() {
    systemLog(LogPriority::Warning, "LTELogGenerator is destructed %p",
              static_cast<const void*>(this));
}

std::unique_ptr<LogGenerator> LTELogGenerator::generator(const GeneratorEnvironment& environment) {
    return std::make_unique<LTELogGenerator>(environment);
}

} // namespace pallax
