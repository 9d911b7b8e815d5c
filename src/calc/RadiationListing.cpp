#include "calc/RadiationListing.h"

#include "calc/ListingTables.h"
#include "calc/RadiationTexts.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <array>

namespace pyr {

namespace {

using Row = ListingRow;

// The columns the surveyor may choose, with their titles.
struct Column {
    const char* token;
    const char* title;
};
constexpr std::array<Column, 11> kColumns{{{"N", "Matricule"},
                                           {"X", "X"},
                                           {"Y", "Y"},
                                           {"Z", "Z"},
                                           {"GI", "Gis."},
                                           {"DH", "DH"},
                                           {"HP", "HP"},
                                           {"AH", "AH"},
                                           {"AV", "AV"},
                                           {"DI", "DI"},
                                           {"CS", "Code"}}};

const Column* ColumnOf(std::string_view token) {
    for (const Column& column : kColumns)
        if (EqualIgnoringCase(token, column.token)) return &column;
    return nullptr;
}

// The title of a column; X and Y exchanged when the surveyor shows the northing first.
std::string Title(const std::string& token) {
    const bool swap = CPointGen::SwapXY();
    if (swap && token == "X") return "Y";
    if (swap && token == "Y") return "X";
    return ColumnOf(token)->title;
}

std::string Cell(const CDlgCfgListing& listing, const RadiatedSighting& s, const std::string& token) {
    const bool swap = CPointGen::SwapXY();
    if (token == "N") return s.mat;
    if (token == "X") return listing.FormatCoor(swap ? s.y : s.x);
    if (token == "Y") return listing.FormatCoor(swap ? s.x : s.y);
    if (token == "Z") return listing.FormatAlti(s.z);
    if (token == "GI") return listing.FormatAngl(s.bearing, -1, true);
    if (token == "DH") return listing.FormatDist(s.dh);
    if (token == "HP") return listing.FormatAlti(s.hp);
    if (token == "AH") return listing.FormatAngl(s.ah, -1, true);
    if (token == "AV") return listing.FormatAngl(s.av);
    if (token == "DI") return listing.FormatDist(s.di);
    return s.code;
}

void WriteStationHeading(CDlgCfgListing& listing, const RadiatedStation& result) {
    const StationPlace& station = result.station;
    DrawFrame(listing, {Sprintf(rayon::kListStation, station.name.c_str(), station.reprise)}, true);
    const bool swap = CPointGen::SwapXY();
    listing.WriteLine(rayon::kListStationPlace, listing.FormatCoor(swap ? station.y : station.x).c_str(),
                      listing.FormatCoor(swap ? station.x : station.y).c_str(),
                      listing.FormatAlti(station.z).c_str(), listing.FormatAlti(station.hi).c_str());
    listing.WriteLine("\n");
    const std::string v0 = listing.FormatAngl(station.v0, -1, true);
    if (result.v0Computed)
        listing.WriteLine(rayon::kListV0Computed, v0.c_str(), result.v0.used,
                          listing.FormatAngl(result.v0.station.v0, -1, true).c_str());
    else
        listing.WriteLine(rayon::kListV0Own, v0.c_str());
    listing.WriteLine("\n");
    Blank(listing);
}

void WritePoints(CDlgCfgListing& listing, const RadiatedStation& result,
                 const std::vector<std::string>& columns) {
    if (result.points.empty()) return;
    std::vector<Row> rows;
    rows.reserve(result.points.size() + 1);
    Row titles;
    for (const std::string& token : columns)
        titles.push_back(Title(token));
    rows.push_back(std::move(titles));
    for (const RadiatedSighting& point : result.points) {
        Row row;
        row.reserve(columns.size());
        for (const std::string& token : columns)
            row.push_back(Cell(listing, point, token));
        rows.push_back(std::move(row));
    }
    listing.rtfWriteTabTitle(rayon::kListPointsTitle);
    // The identifier and the code are texts; the others numbers.
    const bool nameFirst = !columns.empty() && (columns.front() == "N" || columns.front() == "CS");
    DrawTable(listing, rows, true, nameFirst ? 1 : 0);
    Blank(listing);
}

void WriteChecks(CDlgCfgListing& listing, const RadiatedStation& result) {
    if (result.checks.empty()) return;
    std::vector<Row> rows{Row(std::begin(rayon::kListCheckColumns), std::end(rayon::kListCheckColumns))};
    for (const RadiationCheck& check : result.checks)
        rows.push_back({check.sighting.mat, listing.FormatAngl(check.sighting.bearing, -1, true),
                        listing.FormatDist(check.sighting.dh), listing.FormatDeni(check.along),
                        listing.FormatDeni(check.across), listing.FormatDeni(check.dz)});
    listing.rtfWriteTabTitle(rayon::kListChecksTitle);
    DrawTable(listing, rows, true, 1);
    Blank(listing);
}

void WriteSkipped(CDlgCfgListing& listing, const RadiatedStation& result) {
    if (result.skipped.empty()) return;
    Row lines{rayon::kListSkippedTitle};
    for (const SkippedSighting& skipped : result.skipped)
        lines.push_back(Sprintf(rayon::kListSkipped, skipped.mat.c_str(), skipped.reason.c_str()));
    DrawFrame(listing, lines, false);
    Blank(listing);
}

void WriteMultiple(CDlgCfgListing& listing, const RadiationReport& report) {
    const bool swap = CPointGen::SwapXY();
    for (const RadiatedPoint& point : report.points) {
        if (point.determinations.size() < 2) continue;
        std::vector<Row> rows{
            Row(std::begin(rayon::kListMultipleColumns), std::end(rayon::kListMultipleColumns))};
        if (swap) std::swap(rows[0][2], rows[0][3]);
        for (const Determination& d : point.determinations) {
            const RadiatedStation& station = report.stations[d.station];
            const RadiatedSighting& s = station.points[d.point];
            rows.push_back({point.mat, station.station.Designation(), listing.FormatCoor(swap ? s.y : s.x),
                            listing.FormatCoor(swap ? s.x : s.y), listing.FormatAlti(s.z)});
        }
        rows.push_back({point.mat, rayon::kListMean, listing.FormatCoor(swap ? point.y : point.x),
                        listing.FormatCoor(swap ? point.x : point.y), listing.FormatAlti(point.z)});
        DrawTable(listing, rows, true, 2);
        listing.WriteLine(rayon::kListSpread, listing.FormatDist(point.spreadXY).c_str(),
                          listing.FormatAlti(point.spreadZ).c_str(),
                          point.outOfTolerance ? rayon::kListOutOfTolerance : "");
        listing.WriteLine("\n");
        Blank(listing);
    }
}

void WriteUnused(CDlgCfgListing& listing, const RadiationReport& report) {
    Row lines{rayon::kListUnusedTitle};
    for (const RadiatedStation& result : report.stations)
        if (!result.usable)
            lines.push_back(
                Sprintf(rayon::kListSkipped, result.station.Designation().c_str(), result.reason.c_str()));
    if (lines.size() > 1) DrawFrame(listing, lines, true);
}

} // namespace

std::vector<std::string> RadiationColumns(std::string_view text) {
    std::vector<std::string> columns;
    while (!text.empty()) {
        const std::size_t comma = text.find(',');
        const std::string_view token = Trimmed(text.substr(0, comma));
        if (const Column* column = ColumnOf(token)) columns.emplace_back(column->token);
        text = comma == std::string_view::npos ? std::string_view() : text.substr(comma + 1);
    }
    return columns.empty() ? RadiationColumns(rayon::kDefaultColumns) : columns;
}

void WriteRadiation(CDlgCfgListing& listing, const RadiationReport& report) {
    for (const RadiatedStation& result : report.stations) {
        if (!result.usable) continue;
        WriteStationHeading(listing, result);
        WritePoints(listing, result, report.columns);
        if (report.checks) WriteChecks(listing, result);
        WriteSkipped(listing, result);
    }
    const bool multiple = std::any_of(report.points.begin(), report.points.end(),
                                      [](const RadiatedPoint& p) { return p.determinations.size() > 1; });
    if (multiple) {
        DrawFrame(listing, {rayon::kListMultipleTitle}, true);
        Blank(listing);
        WriteMultiple(listing, report);
    }
    WriteUnused(listing, report);
}

void WriteRadiationTolerances(CDlgCfgListing& listing, const RadiationSettings& settings, bool checks) {
    const Tolerances& t = settings.tolerances;
    listing.WriteLine(rayon::kListTolerances, listing.FormatDist(t.customDistance).c_str(),
                      listing.FormatAlti(t.customHeight).c_str());
    listing.WriteLine("\n");
    listing.WriteLine(rayon::kListOptions, settings.replaceZeroTargetHeight ? "oui" : "non",
                      settings.computeV0 ? "oui" : "non", checks ? "oui" : "non");
    listing.WriteLine("\n");
}

} // namespace pyr
