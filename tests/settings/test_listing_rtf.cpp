#include "SettingsTestSupport.h"
#include "core/TextEncoding.h"
#include "settings/ListingFlow.h"

namespace pyr::test {
namespace {

using namespace std::string_literals;

// The text that an independent reader (unrtf) finds in an RTF file, as UTF-8, with runs of blanks as
// one (the reader collapses them, as a word processor's display would not); empty without the reader.
std::string ReadRtfAsText(const std::string& file) {
    if (std::system("command -v unrtf >/dev/null 2>&1") != 0) return {};
    std::string command = "unrtf --text '";
    for (char c : file)
        command += c == '\'' ? std::string("'\\''") : std::string(1, c);
    std::FILE* pipe = popen((command + "' 2>/dev/null").c_str(), "r");
    std::string bytes;
    for (int c; pipe && (c = std::fgetc(pipe)) != EOF;)
        if (c != ' ' || bytes.empty() || bytes.back() != ' ') bytes += static_cast<char>(c);
    if (pipe) pclose(pipe);
    return FileBytesToUtf8(bytes); // unrtf writes Latin-1 text
}

class ListingRtf : public SettingsTest {};

TEST_F(ListingRtf, AnIndependentReaderFindsTheHeadingTitleAndTableCells) {
    WriteBytes(path, "[Options_Listings]\nChoixNomListing=0\nAfficherListing=0\n[Listings]\nFormat=0\n");
    ListingRequest request;
    request.paramPath = path;
    request.geobasePath = folder / "relevé d'été.geo";
    request.kind = ListingKind::StationV0;
    request.resultCount = 2;
    request.writeResult = [](CDlgCfgListing& listing, std::size_t index) {
        listing.rtfWriteTabTitle("Calcul du V0 de la station");
        listing.rtfInitTab(2, 3);
        listing.rtfSetColWidth(0, 12);
        listing.rtfSetCellValue(0, 0, "Référence");
        listing.rtfSetCellValue(0, 1, "Gis.");
        listing.rtfSetCellStyle(0, -1, kRtfBold);
        listing.rtfSetCellShading(0, -1, 20);
        listing.rtfSetCellValue(1, 0, index == 0 ? "Clocher {église}" : "Borne\\12");
        listing.rtfSetCellValue(1, 1, listing.FormatAngl(-12.5, 4, true));
        listing.rtfSetCellAlign(1, -1, RtfAlign::Right);
        EXPECT_EQ(listing.rtfDrawTab(), 2);
        listing.WriteLine("| Remarques | σ0 = %.1f |\n", 1.5);
    };
    const std::string file = WriteComputationListing(frontEnd, request);
    ASSERT_EQ(file, folder / "relevé d'été.rtf");
    const std::string rtf = ReadBytes(file);
    int depth = 0; // groups open and close in pairs, escaped characters aside
    for (std::size_t i = 0; i < rtf.size(); i += rtf[i] == '\\' ? 2 : 1)
        depth += (rtf[i] == '{') - (rtf[i] == '}');
    EXPECT_EQ(depth, 0);
    for (const char* word : {"\\trowd", "\\cellx", "\\intbl", "\\row", "\\page", "\\u963?"})
        EXPECT_NE(rtf.find(word), std::string::npos) << word;

    const std::string text = ReadRtfAsText(file);
    if (text.empty()) GTEST_SKIP() << "unrtf is not installed";
    std::size_t at = 0;
    for (const std::string& expected :
         {"PYRALIS CALCULS TOPOMETRIQUES - CALCUL DES V0 DE STATIONS"s,
          "Nom de la GéoBase traitée : " + request.geobasePath, "Calcul du V0 de la station"s, "Référence"s,
          "Gis."s, "Clocher {église}"s, "387.5000"s, "| Remarques |"s, "CALCUL DES V0 DE STATIONS"s,
          "Borne\\12"s}) {
        at = text.find(expected, at);
        ASSERT_NE(at, std::string::npos) << expected << "\n--- unrtf ---\n" << text;
    }
}

} // namespace
} // namespace pyr::test
