// Every instrument format whatever the machine that transferred its book: LF, CRLF, CR alone, blanks
// before the line end, and the transfer controls (STX before, ETX, EOT, Ctrl-Z after) give the same
// elements with the same values and nothing to report.
#include "FieldBookTestSupport.h"
#include "fieldbook/LectNikon.h"
#include "fieldbook/LectSokkia.h"
#include "fieldbook/LectTopcon.h"
#include "fieldbook/LectWild.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

// The book's lines with each line end and transfer framing, then the format's own `quirks`.
std::vector<std::string> Books(const std::vector<std::string>& lines, std::vector<std::string> quirks = {}) {
    const std::string framing[][3] = {
        {"", "\n", ""}, {"", "\r\n", ""}, {"", "\r", ""}, {"\x02", "  \r\n", "\x03\r\n\x04\n\x1a"}};
    for (const auto& [start, end, after] : framing) {
        std::string text = start;
        for (const std::string& line : lines)
            text += line + end;
        quirks.push_back(text + after);
    }
    return quirks;
}

// Each book gives `elements`, and element `at` the values HP, AH, AV, DI.
template <class Reader, FieldBookFormat kFormat>
void ExpectSame(const std::vector<std::string>& books, const std::string& elements, int at,
                const std::vector<double>& values) {
    for (const std::string& text : books) {
        SCOPED_TRACE(text);
        DriverRun<Reader, kFormat> run;
        const CCarnet& read = run.Read(text);
        EXPECT_EQ(ReportText(run), "");
        ASSERT_EQ(ElementsSummary(read), elements);
        ExpectValues(read, at, values);
    }
}

} // namespace

TEST(LineEnds, EveryFormatGivesTheSameElementsWhateverItsLineEndsAndTransferBytes) {
    ExpectSame<CLectTopcon, FieldBookFormat::TopconGT7>(
        Books({"STN     S1,1.500,", "SS      101,1.300,ARB", "SD      100.0000,100.0000,10.000",
               "NOTE    D\xe9part"}),
        "1001 S1; 1009 ARB; 1003 101; 1000 Départ; ", 2, {1.3, 100.0, 100.0, 10.0});
    ExpectSame<CLectNikon, FieldBookFormat::NikonAtlas>(
        Books({"MP,A1,,2000.000,1100.000,100.000,", "ST,S1,,A1,,1.550,,",
               "F1,,1.300,100.001,100.0000,99.8563,10:00:00"}),
        "1006 A1; 1001 S1; 1000 Station <S1> : référence <A1>; 1002 A1; ", 3, {1.3, 100.0, 99.8563, 100.001});
    // SDR33 fields of 16 characters: identifiers right-justified, values left-justified.
    const auto Id = [](std::string id) { return std::string(16 - id.size(), ' ') + id; };
    const auto Re = [](std::string value) { return value + std::string(16 - value.size(), ' '); };
    ExpectSame<CLectSokkia, FieldBookFormat::Sokkia>(
        Books({"02TP" + Id("S1") + Re("2000") + Re("1000") + Re("100.000") + Re("1.550") + Re(""),
               "09F1" + Id("S1") + Id("P") + Re("10") + Re("100") + Re("20") + Re("ARB")}),
        "1000 Format               = SDR33; 1006 S1; 1001 S1; 1009 ARB; 1003 P; ", 4,
        {kUndefined, 20.0, 100.0, 10.0});
    // GSI: several CRs, a comment line, blank lines and blanks before the blocks too.
    const std::string station = "110001+00000S10 84..10+00010000 85..10+00020000 ";
    const std::string sighting = "110002+00000101 21.102+12345678 22.102+09876543 31..00+00012345 ";
    ExpectSame<CLectWild, FieldBookFormat::Wild>(
        Books({station, sighting},
              {station + "\r\r\r" + sighting + "\r\r\r",
               "!Commentaire du chantier\n" + station + "    \n\n" + sighting + "      \n\x03\n\x04\n\x1a",
               "\x02" + station + "\r\n  " + sighting + "\r\n\x03"}),
        "1000 Format               = GSI-8; 1006 S10; 1001 S10; 1003 101; ", 3,
        {kUndefined, 123.45678, 98.76543, 12.345});
}
