#pragma once

#include "text/Result.h"

#include <array>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// What a value measures. Values of one measure can be compared with each other.
enum class Measure { Rsrp, Rsrq, Sinr, Rssi, Rscp, EcNo, RxLev, RxQual, CdmaRssi, EvdoRssi, EcIo };

struct MeasureInfo {
    Measure measure;
    std::string_view name; ///< "rsrp", as in profiles
    std::string_view unit; ///< empty if it has none
    std::string_view meaning;
    double worst; ///< of the values that are usual: where a bar is empty
    double best;  ///< where it is full
};

inline constexpr auto kMeasures = std::to_array<MeasureInfo>({
    {Measure::Rsrp, "rsrp", "dBm", "LTE reference signal received power", -140, -44},
    {Measure::Rsrq, "rsrq", "dB", "LTE reference signal received quality", -20, -3},
    {Measure::Sinr, "sinr", "dB", "LTE signal to interference and noise ratio", -20, 30},
    {Measure::Rssi, "rssi", "dBm", "LTE received signal strength over the whole bandwidth", -110,
     -30},
    {Measure::Rscp, "rscp", "dBm", "UMTS received signal code power", -120, -25},
    {Measure::EcNo, "ecno", "dB", "UMTS energy per chip over noise (Ec/No, Ec/Io)", -24, 0},
    {Measure::RxLev, "rxlev", "dBm", "GSM receive level", -110, -48},
    {Measure::RxQual, "rxqual", "", "GSM receive quality, 0 (best) to 7", 7, 0},
    {Measure::CdmaRssi, "cdma-rssi", "dBm", "CDMA 1x received power", -110, -40},
    {Measure::EvdoRssi, "evdo-rssi", "dBm", "CDMA EV-DO received power", -110, -40},
    {Measure::EcIo, "ecio", "dB", "CDMA 1x pilot energy per chip over received power", -24, 0},
});

const MeasureInfo& infoOf(Measure measure);
std::optional<Measure> measureNamed(std::string_view name);

/// The worst first.
enum class Grade { None, Poor, Fair, Good, Excellent };
std::string_view nameOf(Grade grade);

/// The borders of the grades of one measure, the best first. Values have a grade up to its border,
/// the border included; beyond the last one they have `None`.
struct Borders {
    struct Border {
        Grade grade;
        double value;

        friend bool operator==(const Border&, const Border&) = default;
    };
    std::vector<Border> borders;

    /// Whether smaller values are better, as borders that ascend tell.
    bool isSmallerBetter() const;
    Grade gradeOf(double value) const;

    friend bool operator==(const Borders&, const Borders&) = default;
};

/// A named opinion: no standard says which level is good.
struct QualityProfile {
    std::string name;
    std::string source; ///< one line: where the borders are from
    std::map<Measure, Borders> borders;

    /// Nothing if the profile has no borders for the measure.
    std::optional<Grade> gradeOf(Measure measure, double value) const;
};

/// One sentence that names file and line.
struct ProfileError {
    std::string sentence;
};

/// Reads a profile in the format of settings:
///
///   source = survey of the south-west, 2026
///   rsrp = excellent -80, good -90, fair -100, poor -120
///
/// The borders of a measure descend, or ascend if smaller values are better; grades can be left
/// out.
Result<QualityProfile, ProfileError> parseProfile(std::string_view text, std::string_view name,
                                                  std::string_view file);

/// The profiles of this program in the same format, with their names: "android" (the default),
/// "field" and "operator".
struct BuiltInProfile {
    std::string_view name;
    std::string_view text;
};
const std::vector<BuiltInProfile>& builtInProfiles();
/// A profile of this program; nothing if it has none with that name.
std::optional<QualityProfile> builtInProfile(std::string_view name);

inline constexpr std::string_view kDefaultProfile = "android";

} // namespace pallax
