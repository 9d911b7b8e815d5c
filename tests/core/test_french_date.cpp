// Dates in French whatever the locale; the days of the week worked out by hand from 1 January 2025
// (a Wednesday) and 1 January 2024 (a Monday).
#include "core/FrenchDate.h"

#include <clocale>
#include <gtest/gtest.h>

namespace {

std::tm Date(int year, int month, int day, int weekday, int hour, int minute) {
    std::tm when{};
    when.tm_year = year - 1900, when.tm_mon = month - 1, when.tm_mday = day;
    when.tm_wday = weekday, when.tm_hour = hour, when.tm_min = minute;
    return when;
}

TEST(FrenchDate, DayAndMonthNamesAndTheJournalsFormat) {
    const char* format = "%A %d %B %Y à %H h %M mn";
    EXPECT_EQ(pyr::FormatFrenchDate(format, Date(2025, 3, 3, 1, 9, 5)), "lundi 03 mars 2025 à 09 h 05 mn");
    EXPECT_EQ(pyr::FormatFrenchDate(format, Date(2024, 2, 29, 4, 23, 59)),
              "jeudi 29 février 2024 à 23 h 59 mn");
    EXPECT_EQ(pyr::FormatFrenchDate(format, Date(2026, 8, 15, 6, 0, 0)), "samedi 15 août 2026 à 00 h 00 mn");
    EXPECT_EQ(pyr::FormatFrenchDate("%a %d/%m/%y %b %% %q", Date(2025, 12, 7, 0, 0, 0)),
              "dim. 07/12/25 déc. % %q");
}

TEST(FrenchDate, TheUsersLocaleChangesNothing) {
    if (!std::setlocale(LC_ALL, "en_US.UTF-8") && !std::setlocale(LC_ALL, "C.UTF-8")) GTEST_SKIP();
    EXPECT_EQ(pyr::FormatFrenchDate("%A %B", Date(2025, 1, 1, 3, 0, 0)), "mercredi janvier");
    std::setlocale(LC_ALL, "C");
}

} // namespace
