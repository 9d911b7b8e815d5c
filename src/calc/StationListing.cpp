#include "calc/StationListing.h"

#include "calc/IntersectionListing.h"
#include "calc/ListingTables.h"
#include "core/Angles.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <string>
#include <vector>

namespace pyr {

namespace {

constexpr const char* kTitle = "Calcul de la station %s, reprise %d";
constexpr const char* kPlanimetry = "Calcul en planimétrie";
constexpr const char* kAltimetry = "Calcul en altimétrie, hauteur d'instrument = %s";
constexpr const char* kColumnSighting = " Matricule  visée ";
constexpr const char* kColumnSightingWithKind = " Matricule visée R";
constexpr const char* kApproximatePlace = "P approché :";
constexpr const char* kComputedPlace = "P calculé :";
constexpr const char* kEmqPlace = "EMQ (m/Gr) :";
constexpr const char* kApproximateZ = "Z approché :";
constexpr const char* kComputedZ = "Z calculé :";
constexpr const char* kEmqZ = "EMQ (m) :";
// The mark of the three sightings that gave the approximate place, and what it says.
constexpr const char* kUsedMark = " *";
constexpr const char* kUsedLegend = "* : visées de la solution approchée";
// The direction of a line of sight: from the station on a known point, or on the station from another.
constexpr const char* kFromStation = "-->";
constexpr const char* kOnStation = "<--";

// The sighting's known end, with the other station's occurrence for a sighting taken on the station.
std::string SightingCell(const StationSighting& s, bool kinds) {
    std::string cell = s.onStation ? Sprintf("%s (%d)", s.reference.c_str(), s.reprise) : s.reference;
    if (kinds) cell = std::string(s.onStation ? kOnStation : kFromStation) + " " + cell;
    return cell;
}

// The bearing of the line of sight from its known end or from the station, V0 + AH.
double SightBearing(const StationSighting& s, double v0) {
    const double orientation = s.onStation ? s.v0s : v0;
    return IsKnown(orientation) && IsKnown(s.ah) ? WrapGrads(orientation + s.ah) : kUndefined;
}

void WritePlanimetry(CDlgCfgListing& listing, const StationResult& result, bool kinds) {
    listing.rtfWriteTabTitle(kPlanimetry);
    if (!(result.flags & kStationComputed)) {
        listing.WriteLine("%s\n", result.status.c_str());
        return;
    }
    std::vector<ListingRow> rows{
        {kinds ? kColumnSightingWithKind : kColumnSighting, "AH", "Gisement", "DH", "V mgon", "El m"}};
    for (const StationSighting& s : result.sightings) {
        if (IsUndefined(s.v)) continue;
        rows.push_back({SightingCell(s, kinds) + (s.used ? kUsedMark : ""),
                        listing.FormatAngl(s.ah, -1, true),
                        listing.FormatAngl(SightBearing(s, result.v0), -1, true), listing.FormatDist(s.dh),
                        Milligrads(s.v), listing.FormatDist(s.e)});
    }
    DrawTable(listing, rows, true, 1);
    listing.WriteLine("%s\n", kUsedLegend);
    Blank(listing);

    const bool swap = CPointGen::SwapXY();
    auto row = [&](const char* label, double x, double y, double v0, bool error) {
        const double first = swap ? y : x, second = swap ? x : y;
        if (error)
            return ListingRow{label, listing.FormatDist(first), listing.FormatDist(second),
                              listing.FormatAngl(v0)};
        return ListingRow{label, listing.FormatCoor(first), listing.FormatCoor(second),
                          listing.FormatAngl(v0)};
    };
    DrawTable(listing,
              {{"", swap ? "Y" : "X", swap ? "X" : "Y", "V0"},
               row(kApproximatePlace, result.x0, result.y0, result.v0Approx, false),
               row(kComputedPlace, result.x, result.y, result.v0, false),
               row(kEmqPlace, result.emqX, result.emqY, result.emqV0, true)},
              true, 1);
}

void WriteAltimetry(CDlgCfgListing& listing, const StationResult& result, bool kinds) {
    listing.rtfWriteTabTitle(Sprintf(kAltimetry, listing.FormatAlti(result.hi).c_str()));
    std::vector<ListingRow> rows{
        {kinds ? kColumnSightingWithKind : kColumnSighting, "HP", "AV", "DH", "Z St.", "Vz mgon", "Ez m"}};
    for (const StationSighting& s : result.sightings) {
        if (IsUndefined(s.zi)) continue;
        rows.push_back({SightingCell(s, kinds), listing.FormatAlti(s.hp), listing.FormatAngl(s.av),
                        listing.FormatDist(s.dh), listing.FormatAlti(s.zi), Milligrads(s.vz),
                        listing.FormatAlti(s.ez)});
    }
    DrawTable(listing, rows, true, 1);
    Blank(listing);
    DrawTable(listing,
              {{kApproximateZ, listing.FormatAlti(result.z0)},
               {kComputedZ, listing.FormatAlti(result.z)},
               {kEmqZ, listing.FormatAlti(result.emqZ)}},
              false, 1);
}

} // namespace

void WriteStationResult(CDlgCfgListing& listing, const StationResult& result, bool kinds) {
    DrawFrame(listing, {Sprintf(kTitle, result.station.c_str(), result.reprise)}, true);
    Blank(listing);
    // A planimetry switched off leaves no flag; one that was tried says how it ended.
    if (result.flags != 0) {
        WritePlanimetry(listing, result, kinds);
        Blank(listing);
    }
    if (result.altitudes > 0) {
        WriteAltimetry(listing, result, kinds);
        Blank(listing);
    }
}

} // namespace pyr
