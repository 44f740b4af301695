#pragma once

#include "platform/Bundle.h"

namespace pallax::doubles {

/// A bundle with public fields.
class FakeBundle final : public Bundle {
public:
    std::optional<std::string> bundleVersion = "1.0";
    std::string builtAt = "Sep 13 2024 00:18:26";

    std::optional<std::string> version() const override { return bundleVersion; }
    std::string buildDate() const override { return builtAt; }
};

} // namespace pallax::doubles
