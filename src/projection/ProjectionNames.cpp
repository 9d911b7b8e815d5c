#include "projection/ProjectionNames.h"

#include "core/Strings.h"
#include "projection/ProjectionMessages.h"

#include <array>
#include <charconv>

namespace pyr {

namespace {

constexpr int kEpsgLambert93 = 2154;
constexpr int kEpsgFirstConicZone = 3942; // CC42; CC50 is 3950
constexpr int kFirstConicZone = 42;
constexpr int kLastConicZone = 50;
// NTF (Paris) Lambert zones: 2757z the zone "carto" (Lambert II carto is Lambert II étendu), 2756z the
// same zone with its northing from 200 000 (Nord, Centre, Sud, Corse).
constexpr int kEpsgLambertCarto = 27570;
constexpr int kEpsgLambertRegional = 27560;
constexpr int kEpsgUtmNorth = 32600; // WGS 84 / UTM zone zzN
constexpr int kEpsgUtmSouth = 32700; // WGS 84 / UTM zone zzS

// The name without blanks, '-' and '_', ASCII letters in lower case, é è ê (UTF-8) read as e.
std::string Folded(std::string_view name) {
    std::string folded;
    for (std::size_t i = 0; i < name.size(); ++i) {
        const char c = name[i];
        if (c == ' ' || c == '\t' || c == '-' || c == '_') continue;
        if (c == '\xC3' && i + 1 < name.size()) {
            const char next = name[i + 1];
            if (next == '\xA9' || next == '\x89' || next == '\xA8' || next == '\x88' || next == '\xAA' ||
                next == '\x8A') {
                folded += 'e';
                ++i;
                continue;
            }
        }
        folded += (c >= 'A' && c <= 'Z') ? static_cast<char>(c - 'A' + 'a') : c;
    }
    return folded;
}

bool StartsWith(std::string_view text, std::string_view prefix) {
    return text.substr(0, prefix.size()) == prefix;
}

// The whole text as a number of at most `maxDigits` digits.
bool ReadNumber(std::string_view digits, int maxDigits, int& value) {
    if (digits.empty() || static_cast<int>(digits.size()) > maxDigits) return false;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), value);
    return error == std::errc() && end == digits.data() + digits.size();
}

// "lambert2etendu", "lamberti", "lambertiiicarto", "lambertivcorse" ...: the EPSG code, or 0.
int NtfLambertZone(std::string_view folded) {
    struct Zone {
        std::string_view roman, arabic, region;
    };
    static constexpr std::array<Zone, 4> kZones{{
        {"i", "1", "nord"},
        {"ii", "2", "centre"},
        {"iii", "3", "sud"},
        {"iv", "4", "corse"},
    }};
    if (!StartsWith(folded, "lambert")) return 0;
    const std::string_view rest = folded.substr(7);
    for (int zone = 1; zone <= 4; ++zone) {
        const Zone& z = kZones[static_cast<std::size_t>(zone - 1)];
        for (std::string_view number : {z.roman, z.arabic}) {
            if (!StartsWith(rest, number)) continue;
            const std::string_view suffix = rest.substr(number.size());
            if (suffix.empty() || suffix == "carto") return kEpsgLambertCarto + zone;
            if (suffix == z.region) return kEpsgLambertRegional + zone;
            if (zone == 2 && (suffix == "etendu" || suffix == "e")) return kEpsgLambertCarto + zone;
        }
    }
    return 0;
}

// "utm31n", "utm40s", "utm20nord" ...
ProjectionName UtmZone(std::string_view folded, std::string_view name) {
    ProjectionName result;
    std::string_view rest = folded.substr(3);
    std::size_t digits = 0;
    while (digits < rest.size() && rest[digits] >= '0' && rest[digits] <= '9')
        ++digits;
    int zone = 0;
    const std::string_view hemisphere = rest.substr(digits);
    const std::string shown(name);
    if (!ReadNumber(rest.substr(0, digits), 2, zone)) {
        result.error = Sprintf(msg::kProjectionUnknown, shown.c_str());
    } else if (zone < 1 || zone > 60) {
        result.error = Sprintf(msg::kProjectionUtmZone, shown.c_str());
    } else if (hemisphere == "n" || hemisphere == "nord" || hemisphere == "north") {
        result.epsg = kEpsgUtmNorth + zone;
    } else if (hemisphere == "s" || hemisphere == "sud" || hemisphere == "south") {
        result.epsg = kEpsgUtmSouth + zone;
    } else if (hemisphere.empty()) {
        result.error = Sprintf(msg::kProjectionUtmHemisphere, shown.c_str());
    } else {
        result.error = Sprintf(msg::kProjectionUnknown, shown.c_str());
    }
    return result;
}

} // namespace

ProjectionName ResolveProjectionName(std::string_view name) {
    name = Trimmed(name);
    const std::string folded = Folded(name);
    ProjectionName result;
    int number = 0;
    if (folded.empty() || folded == "aucune") {
        result.none = true;
    } else if (folded == "lambert93" || folded == "l93") {
        result.epsg = kEpsgLambert93;
    } else if ((StartsWith(folded, "cc") && ReadNumber(std::string_view(folded).substr(2), 2, number)) ||
               (StartsWith(folded, "lambertcc") &&
                ReadNumber(std::string_view(folded).substr(9), 2, number))) {
        if (number >= kFirstConicZone && number <= kLastConicZone)
            result.epsg = kEpsgFirstConicZone + number - kFirstConicZone;
    } else if (StartsWith(folded, "utm")) {
        return UtmZone(folded, name);
    } else if (StartsWith(folded, "epsg:")) {
        if (ReadNumber(std::string_view(folded).substr(5), 9, number) && number > 0) result.epsg = number;
    } else {
        result.epsg = NtfLambertZone(folded);
    }
    if (!result.none && result.epsg == 0)
        result.error = Sprintf(msg::kProjectionUnknown, std::string(name).c_str());
    return result;
}

const std::vector<NamedProjection>& OfferedProjections() {
    static const std::vector<NamedProjection> kOffered{
        {"Aucune", 0},
        {"Lambert 93", kEpsgLambert93},
        {"CC42", 3942},
        {"CC43", 3943},
        {"CC44", 3944},
        {"CC45", 3945},
        {"CC46", 3946},
        {"CC47", 3947},
        {"CC48", 3948},
        {"CC49", 3949},
        {"CC50", 3950},
        {"Lambert I", kEpsgLambertCarto + 1},
        {"Lambert II étendu", kEpsgLambertCarto + 2},
        {"Lambert III", kEpsgLambertCarto + 3},
        {"Lambert IV", kEpsgLambertCarto + 4},
        {"Lambert I Nord", kEpsgLambertRegional + 1},
        {"Lambert II Centre", kEpsgLambertRegional + 2},
        {"Lambert III Sud", kEpsgLambertRegional + 3},
        {"Lambert IV Corse", kEpsgLambertRegional + 4},
        {"UTM 30N", kEpsgUtmNorth + 30},
        {"UTM 31N", kEpsgUtmNorth + 31},
        {"UTM 32N", kEpsgUtmNorth + 32},
    };
    return kOffered;
}

} // namespace pyr
