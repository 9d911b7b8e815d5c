#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "settings/ListingFlow.h"

#include <cstdio>
#include <cstdlib>
#include <gtest/gtest.h>
#include <optional>
#include <string>
#include <vector>

namespace pyr::test {
namespace {

// The text that an independent reader (unrtf) finds in an RTF file, as UTF-8; nothing when the reader
// is not installed.
std::optional<std::string> ReadRtfAsText(const std::string& file) {
    if (std::system("command -v unrtf >/dev/null 2>&1") != 0) return std::nullopt;
    std::string quoted = "'";
    for (char c : file)
        quoted += c == '\'' ? std::string("'\\''") : std::string(1, c);
    std::FILE* pipe = popen(("unrtf --text " + quoted + "' 2>/dev/null").c_str(), "r");
    if (!pipe) return std::nullopt;
    std::string bytes;
    char buffer[4096];
    for (std::size_t n; (n = std::fread(buffer, 1, sizeof buffer, pipe)) > 0;)
        bytes.append(buffer, n);
    pclose(pipe);
    return FileBytesToUtf8(bytes); // unrtf writes Latin-1 text
}

// Runs of blanks as one: the reader collapses them, as a word processor's display would not.
std::string CollapseBlanks(std::string_view text) {
    std::string out;
    for (char c : text)
        if (c != ' ' || out.empty() || out.back() != ' ') out += c;
    return out;
}

// The RTF groups open and close in pairs, escaped braces aside.
bool BracesBalance(const std::string& rtf) {
    int depth = 0;
    for (std::size_t i = 0; i < rtf.size(); ++i) {
        if (rtf[i] == '\\')
            ++i;
        else if (rtf[i] == '{')
            ++depth;
        else if (rtf[i] == '}' && --depth < 0)
            return false;
    }
    return depth == 0;
}

class ListingRtf : public SettingsTest {};

TEST_F(ListingRtf, AnIndependentReaderFindsTheHeadingTitleAndTableCells) {
    WriteBytes(path, "[Options_Listings]\nChoixNomListing=0\nAfficherListing=0\nEcrireTolérances=0\n"
                     "[Listings]\nFormat=0\n");
    ListingRequest request;
    request.paramPath = path;
    request.geobasePath = folder / "relevé d'été.geo";
    request.kind = ListingKind::StationV0;
    request.resultCount = 2;
    request.writeResult = [](CDlgCfgListing& listing, std::size_t index) {
        listing.rtfWriteTabTitle("Calcul du V0 de la station (tolérance = 0.0100 Gr)");
        listing.rtfInitTab(2, 3);
        listing.rtfSetColWidth(0, 12);
        listing.rtfSetCellValue(0, 0, "Référence");
        listing.rtfSetCellValue(0, 1, "Gis.");
        listing.rtfSetCellValue(0, 2, "eV0 Gr");
        listing.rtfSetCellStyle(0, -1, kRtfBold);
        listing.rtfSetCellShading(0, -1, 20);
        listing.rtfSetCellValue(1, 0, index == 0 ? "Clocher {église}" : "Borne\\12");
        listing.rtfSetCellValue(1, 1, listing.FormatAngl(-12.5, 4, true));
        listing.rtfSetCellValue(1, 2, listing.FormatAngl(0.0012, 4));
        listing.rtfSetCellAlign(1, -1, RtfAlign::Right);
        EXPECT_EQ(listing.rtfDrawTab(), 2);
        listing.WriteLine("| Remarques | σ0 = %.1f |\n", 1.5);
    };
    const std::string file = WriteComputationListing(frontEnd, request);
    ASSERT_EQ(file, folder / "relevé d'été.rtf");

    const std::string rtf = ReadBytes(file);
    EXPECT_TRUE(BracesBalance(rtf));
    for (const char* word : {"\\trowd", "\\cellx", "\\intbl", "\\cell", "\\row", "\\page", "\\u963?"})
        EXPECT_NE(rtf.find(word), std::string::npos) << word;

    const auto text = ReadRtfAsText(file);
    if (!text) GTEST_SKIP() << "unrtf is not installed";
    std::size_t at = 0;
    for (const std::string& expected : std::vector<std::string>{
             "PYRALIS CALCULS TOPOMETRIQUES - CALCUL DES V0 DE STATIONS",
             "Nom de la GéoBase traitée : " + request.geobasePath,
             std::string("Calculs effectués le      : "),
             std::string("Calcul du V0 de la station (tolérance = 0.0100 Gr)"), std::string("Référence"),
             std::string("Gis."), std::string("eV0 Gr"), std::string("Clocher {église}"),
             std::string("387.5000"), std::string("0.0012"), std::string("| Remarques |"),
             std::string("PYRALIS CALCULS TOPOMETRIQUES - CALCUL DES V0 DE STATIONS"),
             std::string("Borne\\12")}) {
        const std::size_t found = CollapseBlanks(*text).find(CollapseBlanks(expected), at);
        ASSERT_NE(found, std::string::npos) << expected << "\n--- unrtf ---\n" << *text;
        at = found + 1;
    }
}

} // namespace
} // namespace pyr::test
