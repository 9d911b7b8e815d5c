#include "settings/ListingFlow.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "settings/CalcOptions.h"

#include <filesystem>

namespace pyr {

namespace {

// A name typed without an extension takes the listing's, as a file dialog gives it.
std::string WithExtension(const std::string& path, const std::string& extension) {
    if (std::filesystem::path(path).has_extension()) return path;
    return path + "." + extension;
}

} // namespace

void WriteListingHeading(CDlgCfgListing& listing, const ListingRequest& request, bool writeTolerances) {
    const std::string_view title = ListingKindOf(request.kind).title;
    if (listing.IsRichText()) {
        listing.rtfWriteLstTitle(title);
    } else {
        listing.SetSepLine1(-1, '#');
        listing.SetTitleLine(title, '#');
        listing.WriteLine("\n");
        listing.WriteTitle();
    }
    listing.WriteLine(kListingGeoBaseLine, request.geobasePath.c_str());
    listing.WriteLine(kListingDateLine, CDlgCfgListing::FormatTime().c_str());
    if (writeTolerances && request.writeTolerances) request.writeTolerances(listing);
    listing.WriteLine("\n");
}

std::string WriteComputationListing(ui::FrontEnd& frontEnd, const ListingRequest& request) {
    if (request.resultCount == 0) return {};
    const ListingKindInfo& kind = ListingKindOf(request.kind);
    if (request.ask &&
        frontEnd.Ask(kind.question, ui::kCaption, ui::Buttons::YesNo, ui::Answer::Yes) != ui::Answer::Yes)
        return {};

    CDlgCfgListing listing(frontEnd);
    listing.ReadLastParameters(request.paramPath);
    const bool richText = listing.IsRichText();
    const std::string extension = ListingExtension(request.kind, richText);
    std::string path = CDlgCfgListing::GetListingName(request.geobasePath, extension);

    if (!request.path.empty()) {
        path = WithExtension(request.path, extension);
    } else if (ReadOptionSwitch(request.paramPath, kSectionListings, kKeyChooseListingName)) {
        ui::FileChoice choice;
        choice.save = true;
        choice.title = kListingFileChoiceTitle;
        choice.filter = ListingFilter(request.kind, richText);
        choice.defaultExtension = extension;
        choice.startPath = path;
        if (auto chosen = frontEnd.ChooseFile(choice); chosen && !chosen->empty())
            path = WithExtension(*chosen, extension);
    }

    // A plain-text listing may gather the runs of several days; the person says whether this one
    // continues it. A rich-text document cannot be continued: it is replaced without a word. Replacing
    // never removes the old listing first: the new one takes its place once written whole.
    const bool complete = !richText && FileExists(path) &&
                          frontEnd.Ask(Sprintf(kMsgListingExists, path.c_str()), ui::kCaption,
                                       ui::Buttons::YesNo, ui::Answer::Yes) == ui::Answer::Yes;

    if (!listing.OpenListing(path, complete ? "a" : "w")) {
        frontEnd.ReportFailure(listing.FailureText());
        return {};
    }
    if (listing.GetFormat() != kListingTextNoPageCount) listing.SetPageCount(true);
    listing.SetEcho(false);

    const bool tolerances = ReadOptionSwitch(request.paramPath, kSectionListings, kKeyWriteTolerances);
    for (std::size_t i = 0; i < request.resultCount; ++i) {
        listing.WriteHeader(listing.GetPage() + 1);
        WriteListingHeading(listing, request, tolerances);
        if (request.writeResult) request.writeResult(listing, i);
        listing.WriteFooter();
    }
    if (!listing.CloseListing(path, ReadOptionSwitch(request.paramPath, kSectionListings, kKeyShowListing))) {
        frontEnd.ReportFailure(listing.FailureText());
        return {};
    }
    return path;
}

} // namespace pyr
