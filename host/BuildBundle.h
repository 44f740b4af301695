#pragma once

#include "platform/Bundle.h"

namespace pallax {

/// The version of the project and the time at which this file was compiled.
class BuildBundle final : public Bundle {
public:
    std::optional<std::string> version() const override;
    std::string buildDate() const override;
};

} // namespace pallax
