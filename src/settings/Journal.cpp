#include "settings/Journal.h"

#include "core/FrenchDate.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "core/Undefined.h"
#include "settings/CalcOptions.h"

#include <filesystem>
#include <string>

namespace pyr {

std::string JournalPath(std::string_view geoBasePath) {
    std::filesystem::path path{std::string(geoBasePath)};
    path.replace_extension("jnl");
    return path.string();
}

std::string JournalHeader(std::string_view computation, const std::tm& when) {
    return "\n\n" + FormatFrenchDate(kComputationDateFormat, when) + " - " + std::string(computation);
}

std::string JournalPointLine(std::string_view mat, double x, double y, double z, bool yFirst) {
    const std::string name(mat);
    const bool planimetry = IsKnown(x) && IsKnown(y);
    const bool altimetry = IsKnown(z);
    // The first and second coordinates as the surveyor reads them.
    const char* first = yFirst ? "Y" : "X";
    const char* second = yFirst ? "X" : "Y";
    const double a = yFirst ? y : x;
    const double b = yFirst ? x : y;
    if (planimetry && altimetry)
        return Sprintf("\nPoint %7s : %s = %12.4f %s = %12.4f Z = %9.4f", name.c_str(), first, a, second, b,
                       z);
    if (planimetry)
        return Sprintf("\nPoint %7s : %s = %12.4f %s = %12.4f", name.c_str(), first, a, second, b);
    if (altimetry) return Sprintf("\nPoint %7s : Z = %9.4f", name.c_str(), z);
    return Sprintf("\nPoint %7s : Pas de coordonnées calculées", name.c_str());
}

std::string JournalStationLine(std::string_view station, double v0) {
    return Sprintf("\nStation %7s : V0 = %9.5f", std::string(station).c_str(), v0);
}

bool JournalWanted(std::string_view paramPath) {
    return ReadOptionSwitch(paramPath, kSectionListings, "ProduireJournal");
}

bool CJournal::Append(ui::FrontEnd& frontEnd, const std::tm& when) {
    if (m_lines.empty()) return true;
    std::string text = JournalHeader(m_computation, when);
    for (const std::string& line : m_lines)
        text += line;
    const std::string path = JournalPath(m_geoBasePath);
    if (const int code = AppendToFile(path, text); code != 0) {
        frontEnd.ReportFailure(FileWriteFailure(path, code));
        return false;
    }
    m_lines.clear();
    return true;
}

bool CJournal::Append(ui::FrontEnd& frontEnd) {
    return Append(frontEnd, LocalTimeNow());
}

} // namespace pyr
