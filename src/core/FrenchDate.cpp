#include "core/FrenchDate.h"

#include <array>
#include <cstdio>

namespace pyr {

namespace {

constexpr std::array<const char*, 7> kDays = {"dimanche", "lundi",    "mardi", "mercredi",
                                              "jeudi",    "vendredi", "samedi"};
constexpr std::array<const char*, 7> kShortDays = {"dim.", "lun.", "mar.", "mer.", "jeu.", "ven.", "sam."};
constexpr std::array<const char*, 12> kMonths = {"janvier",   "février", "mars",     "avril",
                                                 "mai",       "juin",    "juillet",  "août",
                                                 "septembre", "octobre", "novembre", "décembre"};
constexpr std::array<const char*, 12> kShortMonths = {"janv.", "févr.", "mars",  "avr.", "mai",  "juin",
                                                      "juil.", "août",  "sept.", "oct.", "nov.", "déc."};

void AppendNumber(std::string& out, int value, int width) {
    char text[16];
    std::snprintf(text, sizeof text, "%0*d", width, value);
    out += text;
}

template <size_t N>
const char* Name(const std::array<const char*, N>& names, int index) {
    return index >= 0 && index < static_cast<int>(N) ? names[static_cast<size_t>(index)] : "?";
}

} // namespace

std::string FormatFrenchDate(std::string_view format, const std::tm& when) {
    std::string out;
    for (size_t i = 0; i < format.size(); ++i) {
        if (format[i] != '%' || i + 1 == format.size()) {
            out += format[i];
            continue;
        }
        switch (format[++i]) {
        case 'A':
            out += Name(kDays, when.tm_wday);
            break;
        case 'a':
            out += Name(kShortDays, when.tm_wday);
            break;
        case 'B':
            out += Name(kMonths, when.tm_mon);
            break;
        case 'b':
            out += Name(kShortMonths, when.tm_mon);
            break;
        case 'd':
            AppendNumber(out, when.tm_mday, 2);
            break;
        case 'm':
            AppendNumber(out, when.tm_mon + 1, 2);
            break;
        case 'Y':
            AppendNumber(out, when.tm_year + 1900, 4);
            break;
        case 'y':
            AppendNumber(out, (when.tm_year + 1900) % 100, 2);
            break;
        case 'H':
            AppendNumber(out, when.tm_hour, 2);
            break;
        case 'M':
            AppendNumber(out, when.tm_min, 2);
            break;
        case 'S':
            AppendNumber(out, when.tm_sec, 2);
            break;
        case '%':
            out += '%';
            break;
        default:
            out += '%';
            out += format[i];
        }
    }
    return out;
}

std::tm LocalTimeNow() {
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    return local;
}

std::string FormatFrenchDateNow(std::string_view format) {
    return FormatFrenchDate(format, LocalTimeNow());
}

} // namespace pyr
