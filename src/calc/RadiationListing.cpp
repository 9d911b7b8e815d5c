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

// The position of each column in kColumns.
std::vector<std::size_t> ColumnRanks(const std::vector<std::string>& columns) {
    std::vector<std::size_t> ranks;
    for (const std::string& token : columns) {
        const Column* column = ColumnOf(token);
        ranks.push_back(column ? static_cast<std::size_t>(column - kColumns.data()) : kColumns.size());
    }
    return ranks;
}

// The text of the column of that rank in kColumns, into the table.
void AddCell(ListingTable& table, const CDlgCfgListing& listing, const RadiatedSighting& s,
             std::size_t rank) {
    const bool swap = CPointGen::SwapXY();
    switch (rank) {
    case 0:
        return table.Add(s.mat);
    case 1:
        return table.Add(listing.FormatCoor(swap ? s.y : s.x));
    case 2:
        return table.Add(listing.FormatCoor(swap ? s.x : s.y));
    case 3:
        return table.Add(listing.FormatAlti(s.z));
    case 4:
        return table.Add(listing.FormatAngl(s.bearing, -1, true));
    case 5:
        return table.Add(listing.FormatDist(s.dh));
    case 6:
        return table.Add(listing.FormatAlti(s.hp));
    case 7:
        return table.Add(listing.FormatAngl(s.ah, -1, true));
    case 8:
        return table.Add(listing.FormatAngl(s.av));
    case 9:
        return table.Add(listing.FormatDist(s.di));
    default:
        return table.Add(s.code);
    }
}

void WriteStationHeading(CDlgCfgListing& listing, const RadiatedStation& result) {
    const StationPlace& station = result.station;
    DrawFrame(listing, {Sprintf(rayon::kListStation, station.name.c_str(), station.reprise)}, true);
    const bool swap = CPointGen::SwapXY();
    listing.WriteLine(rayon::kListStationPlace, listing.FormatCoor(swap ? station.y : station.x).c_str(),
                      listing.FormatCoor(swap ? station.x : station.y).c_str(),
                      listing.FormatAlti(station.z).c_str(), listing.FormatAlti(station.hi).c_str());
    listing.WriteText("\n");
    const std::string v0 = listing.FormatAngl(station.v0, -1, true);
    if (result.v0Computed)
        listing.WriteLine(rayon::kListV0Computed, v0.c_str(), result.v0.used,
                          listing.FormatAngl(result.v0.station.v0, -1, true).c_str());
    else
        listing.WriteLine(rayon::kListV0Own, v0.c_str());
    listing.WriteText("\n");
    Blank(listing);
}

void WritePoints(CDlgCfgListing& listing, const RadiatedStation& result,
                 const std::vector<std::string>& columns, ListingTable& table) {
    if (result.points.empty()) return;
    const std::vector<std::size_t> ranks = ColumnRanks(columns);
    table.Clear(columns.size());
    for (const std::string& column : columns)
        table.Add(Title(column));
    for (const RadiatedSighting& point : result.points)
        for (std::size_t rank : ranks)
            AddCell(table, listing, point, rank);
    listing.rtfWriteTabTitle(rayon::kListPointsTitle);
    // The identifier and the code are texts; the others numbers.
    const bool nameFirst = !columns.empty() && (columns.front() == "N" || columns.front() == "CS");
    DrawTable(listing, table, true, nameFirst ? 1 : 0);
    Blank(listing);
}

void WriteChecks(CDlgCfgListing& listing, const RadiatedStation& result, ListingTable& table) {
    if (result.checks.empty()) return;
    table.Clear(std::size(rayon::kListCheckColumns));
    table.AddRow(rayon::kListCheckColumns);
    for (const RadiationCheck& check : result.checks) {
        table.Add(check.sighting.mat);
        table.Add(listing.FormatAngl(check.sighting.bearing, -1, true));
        table.Add(listing.FormatDist(check.sighting.dh));
        table.Add(listing.FormatDeni(check.along));
        table.Add(listing.FormatDeni(check.across));
        table.Add(listing.FormatDeni(check.dz));
    }
    listing.rtfWriteTabTitle(rayon::kListChecksTitle);
    DrawTable(listing, table, true, 1);
    Blank(listing);
}

void WriteSkipped(CDlgCfgListing& listing, const RadiatedStation& result) {
    if (result.skipped.empty()) return;
    Row lines{rayon::kListSkippedTitle};
    for (const SkippedSighting& skipped : result.skipped)
        lines.push_back(
            Sprintf(rayon::kListSkipped, std::string(skipped.mat).c_str(), skipped.reason.c_str()));
    DrawFrame(listing, lines, false);
    Blank(listing);
}

void WriteMultiple(CDlgCfgListing& listing, const RadiationReport& report, ListingTable& table) {
    const bool swap = CPointGen::SwapXY();
    std::array<std::string_view, std::size(rayon::kListMultipleColumns)> titles;
    std::copy(std::begin(rayon::kListMultipleColumns), std::end(rayon::kListMultipleColumns), titles.begin());
    if (swap) std::swap(titles[2], titles[3]);
    // A station names the determinations of many points: its designation is formed once.
    std::vector<std::string> designations(report.stations.size());
    auto designation = [&](std::uint32_t rank) -> const std::string& {
        std::string& text = designations[rank];
        if (text.empty()) text = report.stations[rank].station.Designation();
        return text;
    };
    for (const RadiatedPoint& point : report.points) {
        if (point.determinations.size() < 2) continue;
        table.Clear(std::size(rayon::kListMultipleColumns));
        table.AddRow(titles);
        auto addRow = [&](std::string_view name, double x, double y, double z) {
            table.Add(point.mat);
            table.Add(name);
            table.Add(listing.FormatCoor(swap ? y : x));
            table.Add(listing.FormatCoor(swap ? x : y));
            table.Add(listing.FormatAlti(z));
        };
        for (const Determination& d : point.determinations) {
            const RadiatedSighting& s = report.stations[d.station].points[d.point];
            addRow(designation(d.station), s.x, s.y, s.z);
        }
        addRow(rayon::kListMean, point.x, point.y, point.z);
        DrawTable(listing, table, true, 2);
        listing.WriteLine(rayon::kListSpread, listing.FormatDist(point.spreadXY).c_str(),
                          listing.FormatAlti(point.spreadZ).c_str(),
                          point.outOfTolerance ? rayon::kListOutOfTolerance : "");
        listing.WriteText("\n");
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
    ListingTable table; // filled again for each table
    for (const RadiatedStation& result : report.stations) {
        if (!result.usable) continue;
        WriteStationHeading(listing, result);
        WritePoints(listing, result, report.columns, table);
        if (report.checks) WriteChecks(listing, result, table);
        WriteSkipped(listing, result);
    }
    const bool multiple = std::any_of(report.points.begin(), report.points.end(),
                                      [](const RadiatedPoint& p) { return p.determinations.size() > 1; });
    if (multiple) {
        DrawFrame(listing, {rayon::kListMultipleTitle}, true);
        Blank(listing);
        WriteMultiple(listing, report, table);
    }
    WriteUnused(listing, report);
}

void WriteRadiationTolerances(CDlgCfgListing& listing, const RadiationSettings& settings, bool checks) {
    const Tolerances& t = settings.tolerances;
    listing.WriteLine(rayon::kListTolerances, listing.FormatDist(t.customDistance).c_str(),
                      listing.FormatAlti(t.customHeight).c_str());
    listing.WriteText("\n");
    listing.WriteLine(rayon::kListOptions, settings.replaceZeroTargetHeight ? "oui" : "non",
                      settings.computeV0 ? "oui" : "non", checks ? "oui" : "non");
    listing.WriteText("\n");
}

} // namespace pyr
