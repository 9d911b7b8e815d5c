#include "fieldbook/LectZeissPlaces.h"

#include <algorithm>
#include <array>

namespace pyr::zeiss {

namespace {

// The columns of a field, counted from 1, within the block.
struct Span {
    int first, last;
    bool Holds(int column) const { return column >= first && column <= last; }
};

Span SpanOf(int place, int width) {
    return {place, std::min(place + width - 1, kInfoWidth)};
}

bool Written(const std::string& occupancy, int column) {
    return column >= 1 && column <= static_cast<int>(occupancy.size()) && occupancy[column - 1] != ' ';
}

bool AnyWritten(const std::string& occupancy, Span span) {
    for (int column = span.first; column <= span.last; ++column)
        if (Written(occupancy, column)) return true;
    return false;
}

// A line whose point id alone fits, whatever the alignment of the fields: what a layout still explains
// of a field book whose codes are not aligned as the instrument would write them.
bool Fits(const InfoPlaces& places, const std::string& occupancy) {
    const Span point = SpanOf(places.point, kPointWidth);
    const Span code = SpanOf(places.code, kCodeWidth);
    const Span information = SpanOf(places.information, kInformationWidth);
    if (!AnyWritten(occupancy, point)) return false;
    for (int column = 1; column <= static_cast<int>(occupancy.size()); ++column)
        if (Written(occupancy, column) && !point.Holds(column) && !code.Holds(column) &&
            !information.Holds(column))
            return false;
    return true;
}

} // namespace

std::vector<InfoPlaces> CandidatePlaces() {
    std::vector<InfoPlaces> candidates{InfoPlaces{}, kInformationCodePoint};
    enum Field { Information, Code, Point };
    constexpr int kWidths[] = {kInformationWidth, kCodeWidth, kPointWidth};
    constexpr int kFree = kInfoWidth - kInformationWidth - kCodeWidth - kPointWidth;
    std::array<Field, 3> order{Information, Code, Point};
    do {
        // The free columns before the first field, after it, after the second, after the third.
        for (int gap = 0; gap <= 3; ++gap) {
            InfoPlaces places;
            int column = 1;
            for (int i = 0; i < 3; ++i) {
                if (gap == i) column += kFree;
                int& place = order[i] == Information ? places.information
                             : order[i] == Code      ? places.code
                                                     : places.point;
                place = column;
                column += kWidths[order[i]];
            }
            if (std::find(candidates.begin(), candidates.end(), places) == candidates.end())
                candidates.push_back(places);
        }
    } while (std::next_permutation(order.begin(), order.end()));
    return candidates;
}

bool Explains(const InfoPlaces& places, const std::string& occupancy) {
    if (!Fits(places, occupancy)) return false;
    const Span point = SpanOf(places.point, kPointWidth);
    const Span code = SpanOf(places.code, kCodeWidth);
    const Span information = SpanOf(places.information, kInformationWidth);
    if (!Written(occupancy, point.last)) return false;
    // The instrument writes the code on the right of its field; transfer programs and books written by hand
    // often start it on the left. Either end will do: the point id and the information tell the layouts
    // apart.
    if (AnyWritten(occupancy, code) && !Written(occupancy, code.last) && !Written(occupancy, code.first))
        return false;
    return !AnyWritten(occupancy, information) || Written(occupancy, information.first);
}

FoundPlaces FindPlaces(const std::vector<std::string>& occupancies) {
    FoundPlaces found;
    found.lines = static_cast<int>(occupancies.size());
    // The lines explained, then those that at least fit, compared in that order.
    std::pair<int, int> best{0, 0};
    for (const InfoPlaces& places : CandidatePlaces()) {
        std::pair<int, int> score{0, 0};
        for (const std::string& occupancy : occupancies) {
            if (Explains(places, occupancy)) ++score.first;
            if (Fits(places, occupancy)) ++score.second;
        }
        if (score > best) {
            best = score;
            found.places = places;
        }
    }
    found.explained = best.first;
    return found;
}

} // namespace pyr::zeiss
