#pragma once

#include "editor/ElementFields.h"
#include "geobase/Carnet.h"

#include <string>
#include <string_view>
#include <vector>

// The views of the editor's lists: all the elements in field order, or those of some kinds (the stations
// with their sightings, the points, the levelling readings, the traverses, the instruments, the
// comments), each with its columns. A cell shows a field of the element as its property page does.
namespace pyr {

struct ViewColumn {
    std::string_view heading;
    // The field shown: the first of these that the element's kind has (a station's HI and a sighting's
    // HP share a column).
    std::vector<FieldKey> keys;
};

struct EditorView {
    std::string_view title; // "Points"
    std::vector<int> kinds; // empty: every element
    // The columns after the element's number (and, for a view of several kinds, its kind); none for the
    // view of every element, whose values are shown as the file writes them.
    std::vector<ViewColumn> columns;
};

const std::vector<EditorView>& EditorViews();

// The headings of a view's table.
std::vector<std::string> ViewHeadings(const EditorView& view);
// The elements the view lists, in GéoBase order (the view of every element lists them all: empty here,
// its ranks being the indices).
std::vector<int> ViewIndices(const CCarnet& carnet, const EditorView& view);
// The line of the element at `index` in the view, columns separated by '\t'.
std::string ViewRow(const CCarnet& carnet, const EditorView& view, int index);

} // namespace pyr
