#pragma once

#include "settings/ListingKinds.h"
#include "settings/ListingObject.h"
#include "ui/FrontEnd.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>

// The listing at the end of a computation, as every computation dialog writes it: the question, the
// file's name, completing or replacing it, the common heading of each result and the display.
namespace pyr {

struct ListingRequest {
    std::string_view paramPath; // the parameter file or registry root of the listing options
    std::string geobasePath;    // the GéoBase computed: names the listing and heads it
    ListingKind kind = ListingKind::Intersection;
    std::size_t resultCount = 0;
    // Writes the computation's own block for result `index` (0 to resultCount - 1), after the heading.
    std::function<void(CDlgCfgListing&, std::size_t index)> writeResult;
    // Writes the tolerances and options the computation used; called in each heading when the option
    // "EcrireTolérances" is set. May be empty.
    std::function<void(CDlgCfgListing&)> writeTolerances;
    // False when the person already asked for the listing ("Fin + Listing"): no question.
    bool ask = true;
    // The listing's file when it was named in advance (on a command line): no file choice, whatever
    // "ChoixNomListing" says. A name without an extension takes the listing's.
    std::string path;
};

// Writes the listing and returns its path, or "" when nothing was written: no result, No to the
// question, or a listing that could not be written (a folder that does not exist, a full disk). That
// last one is told to the front end, naming the file and the reason, as a failure of the command; the
// file stays as it was, and the computation's results (in the GéoBase) stand.
std::string WriteComputationListing(ui::FrontEnd& frontEnd, const ListingRequest& request);

// The heading of one result: the title, the GéoBase, the date, the tolerances when asked for, an empty
// line.
void WriteListingHeading(CDlgCfgListing& listing, const ListingRequest& request, bool writeTolerances);

} // namespace pyr
