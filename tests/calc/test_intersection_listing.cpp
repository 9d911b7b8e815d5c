// The block of one point in the listing of the intersections, written as plain text and read back: the
// titles in order, the values with their decimals, X and Y in the surveyor's order, and never the
// undefined marker or a NaN.
#include "ExactReadings.h"
#include "TestSupport.h"
#include "calc/Intersection.h"
#include "calc/IntersectionListing.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"
#include "ui/ScriptedFrontEnd.h"

#include <array>
#include <string>
#include <tuple>
#include <vector>

namespace pyr::test {
namespace {

// P12 (1234.567, 5678.901, 112.345) read exactly on 1.3 m targets from three stations, S2 in its second
// set-up; the zenith angles bend with curvature and refraction, so that every sighting gives 112.345.
InterResult ThreeStations() {
    const KnownStation stations[] = {{"S1", 1000.0, 5000.0, 100.0, 1.55, 123.4567},
                                     {"S2", 1500.0, 5200.0, 120.3, 1.62, 0.0123},
                                     {"S3", 1800.0, 6000.0, 95.2, 1.48, 387.6543}};
    InterResult result;
    result.mat = "P12";
    for (const KnownStation& st : stations) {
        result.sightings.push_back(SightP(st, {1234.567, 5678.901, 112.345}, 1.3));
        result.sightings.back().reprise = &st == &stations[1] ? 2 : 1;
    }
    return result;
}

class IntersectionListing : public ::testing::Test {
protected:
    // Plain text in one run, with the decimals of a usual job: 4 for coordinates and distances, 3 for
    // altitudes, 5 for angles.
    std::string Write(const InterResult& result) {
        CDlgCfgListing listing{frontEnd};
        listing.SetFormat(kListingTextNoPageCount);
        listing.SetPageWidth(120);
        listing.SetDeciCoor(4);
        listing.SetDeciDist(4);
        listing.SetDeciAlti(3);
        listing.SetDeciAngl(5);
        EXPECT_TRUE(listing.OpenListing(file, "w"));
        WriteIntersectionResult(listing, result);
        EXPECT_TRUE(listing.CloseListing(file, false));
        const std::string text = ReadBytes(file);
        EXPECT_EQ(text.find("999999"), std::string::npos) << text;
        EXPECT_EQ(text.find("nan"), std::string::npos) << text;
        EXPECT_EQ(text.find("inf"), std::string::npos) << text;
        return text;
    }

    ui::ScriptedFrontEnd frontEnd;
    TempDir folder;
    const std::string file = folder / "chantier.cin";
};

// The lines of a text, and the position of the first line that contains `part` from `from` on.
std::vector<std::string> Lines(const std::string& text) {
    std::vector<std::string> lines;
    std::size_t start = 0;
    for (std::size_t end; (end = text.find('\n', start)) != std::string::npos; start = end + 1)
        lines.push_back(text.substr(start, end - start));
    return lines;
}
std::size_t Find(const std::vector<std::string>& lines, const std::string& part, std::size_t from = 0) {
    for (std::size_t i = from; i < lines.size(); ++i)
        if (lines[i].find(part) != std::string::npos) return i;
    return std::string::npos;
}

// The cells of a table line "| a | b |", trimmed.
std::vector<std::string> Cells(const std::string& line) {
    std::vector<std::string> cells;
    std::size_t start = line.find('|');
    for (std::size_t end;
         start != std::string::npos && (end = line.find('|', start + 1)) != std::string::npos; start = end) {
        std::string cell = line.substr(start + 1, end - start - 1);
        cell.erase(0, cell.find_first_not_of(' '));
        cell.erase(cell.find_last_not_of(' ') + 1);
        cells.push_back(cell);
    }
    return cells;
}

TEST_F(IntersectionListing, BothPartsInOrderWithTheirValues) {
    InterResult result = ThreeStations();
    ASSERT_EQ(ComputeIntersection(result, true, true), kInterComputed);
    const auto lines = Lines(Write(result));

    const char* titles[] = {"Calcul du point P12", "Calcul en planimétrie", "P approché :",
                            "P calculé  :",        "EMQ (m)    :",          "Calcul en altimétrie",
                            "Z approché :",        "Z calculé  :",          "EMQ (m)    :"};
    std::array<std::size_t, 9> at{};
    for (std::size_t i = 0; i < at.size(); ++i)
        at[i] = Find(lines, titles[i], i == 0 ? 0 : at[i - 1]);
    const auto [title, plani, approx, computed, emq, alti, approxZ, computedZ, emqZ] = at;
    ASSERT_NE(emqZ, std::string::npos) << "a title is missing or out of order";

    // The sightings' table: S2's row with its reprise, V0, bearing, distance and a nil residual.
    const std::size_t heads = Find(lines, "Station       R", plani);
    ASSERT_LT(heads, approx);
    const std::vector<std::string> s2 = Cells(lines[heads + 2]);
    ASSERT_EQ(s2.size(), 8u);
    EXPECT_EQ(s2[0], "S2            2");
    EXPECT_EQ(s2[2], "0.01230");
    EXPECT_NEAR(std::stod(s2[4]), BearingTo(1500.0, 5200.0, 1234.567, 5678.901), 1e-5);
    EXPECT_NEAR(std::stod(s2[5]), std::hypot(1234.567 - 1500.0, 5678.901 - 5200.0), 1e-4);
    EXPECT_EQ(s2[6] + " " + s2[7], "0.0 0.0000");

    EXPECT_EQ(Cells(lines[approx]), (std::vector<std::string>{"P approché :", "1234.5670", "5678.9010"}));
    EXPECT_EQ(Cells(lines[computed]), (std::vector<std::string>{"P calculé  :", "1234.5670", "5678.9010"}));
    EXPECT_EQ(Cells(lines[emq]), (std::vector<std::string>{"EMQ (m)    :", "0.0000", "0.0000"}));

    // The altitudes: one row a sighting, with HI, HP, Z Pt and Ez m.
    const std::size_t altiHeads = Find(lines, "Z Pt", alti);
    const std::vector<std::string> s1 = Cells(lines[altiHeads + 1]);
    ASSERT_EQ(s1.size(), 9u);
    EXPECT_EQ(s1[2] + " " + s1[3] + " " + s1[6] + " " + s1[8], "1.550 1.300 112.345 0.000");
    EXPECT_EQ(Cells(lines[altiHeads + 3])[0], "S3            1");
    EXPECT_EQ(Cells(lines[approxZ]), (std::vector<std::string>{"Z approché :", "112.345"}));
    EXPECT_EQ(Cells(lines[computedZ]), (std::vector<std::string>{"Z calculé  :", "112.345"}));
    EXPECT_EQ(Cells(lines[emqZ]), (std::vector<std::string>{"EMQ (m)    :", "0.000"}));
}

TEST_F(IntersectionListing, YBeforeXWhenTheJobSwapsThem) {
    InterResult result = ThreeStations();
    ComputeIntersection(result, true, false);
    const bool saved = CPointGen::SwapXY();
    CPointGen::setSwapXY(true);
    const auto lines = Lines(Write(result));
    CPointGen::setSwapXY(saved);
    const std::size_t computed = Find(lines, "P calculé  :");
    ASSERT_NE(computed, std::string::npos);
    EXPECT_EQ(Cells(lines[computed - 2]), (std::vector<std::string>{"", "Y", "X"}));
    EXPECT_EQ(Cells(lines[computed]), (std::vector<std::string>{"P calculé  :", "5678.9010", "1234.5670"}));
    EXPECT_EQ(Find(lines, "Calcul en altimétrie"), std::string::npos); // altimetry off
}

TEST_F(IntersectionListing, OnlyTheComputedPartsAndUndefinedValuesAsDashes) {
    // Planimetry off: the altitude alone.
    InterResult altitudeOnly = ThreeStations();
    ComputeIntersection(altitudeOnly, false, true);
    auto lines = Lines(Write(altitudeOnly));
    EXPECT_EQ(Find(lines, "Calcul en planimétrie"), std::string::npos);
    EXPECT_NE(Find(lines, "Z calculé  :"), std::string::npos);

    // Planimetry failed: the reason, and the altitude from the measured distance.
    InterResult single = ThreeStations();
    single.sightings.resize(1);
    ComputeIntersection(single, true, true);
    lines = Lines(Write(single));
    const std::size_t plani = Find(lines, "Calcul en planimétrie");
    ASSERT_NE(plani, std::string::npos);
    EXPECT_NE(Find(lines, "Une seule visée : Calcul impossible !", plani), std::string::npos);
    EXPECT_EQ(Find(lines, "P calculé"), std::string::npos);
    const std::size_t emqZ = Find(lines, "EMQ (m)    :", Find(lines, "Z calculé  :"));
    ASSERT_NE(emqZ, std::string::npos);
    EXPECT_EQ(Cells(lines[emqZ]), (std::vector<std::string>{"EMQ (m)    :", "-"})); // one altitude

    // Two rays meeting under less than 5 gr: no error, and the warning under the table.
    InterResult weak;
    weak.mat = "P13";
    for (auto [name, x, y] : {std::tuple{"A", 0.0, 0.0}, std::tuple{"B", -62.79, 1.97}}) {
        InterSighting s;
        s.station = name, s.reference = "P13", s.xs = x, s.ys = y, s.v0 = 0.0;
        s.ah = BearingTo(x, y, 0.0, 1000.0);
        weak.sightings.push_back(s);
    }
    ASSERT_EQ(ComputeIntersection(weak, true, true), kInterComputed | kInterTooClose);
    lines = Lines(Write(weak));
    EXPECT_NE(Find(lines, "car les visées sont trop proches (< 5 gr)."), std::string::npos);
    EXPECT_EQ(Cells(lines[Find(lines, "EMQ (m)    :")]),
              (std::vector<std::string>{"EMQ (m)    :", "-", "-"}));
    EXPECT_EQ(Find(lines, "Calcul en altimétrie"), std::string::npos);
}

} // namespace
} // namespace pyr::test
