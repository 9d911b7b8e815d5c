#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "settings/ListingFlow.h"

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <gtest/gtest.h>
#include <set>
#include <string>
#include <vector>

namespace pyr::test {
namespace {

int Count(const std::string& text, const std::string& part) {
    int count = 0;
    for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1))
        ++count;
    return count;
}

class ListingFlow : public SettingsTest {
protected:
    // Listing options and layout as the parameter file holds them.
    void Options(bool chooseName, bool show, bool tolerances, int format) {
        WriteBytes(path, Sprintf("[Options_Listings]\nChoixNomListing=%d\nAfficherListing=%d\n"
                                 "EcrireTolérances=%d\n[Listings]\nFormat=%d\nLongueurPage=30\n",
                                 chooseName, show, tolerances, format));
    }

    ListingRequest Request(ListingKind kind, std::size_t results) {
        ListingRequest request;
        request.paramPath = path;
        request.geobasePath = geobase;
        request.kind = kind;
        request.resultCount = results;
        request.writeResult = [this](CDlgCfgListing& listing, std::size_t index) {
            written.push_back(index);
            listing.WriteLine("|  Calcul du point P%zu  |\n", index + 1);
        };
        request.writeTolerances = [this](CDlgCfgListing& listing) {
            ++toleranceBlocks;
            listing.WriteLine("Tolérance angulaire : %.4f Gr\n", 0.01);
        };
        return request;
    }

    std::set<std::string> FilesInFolder() const {
        std::set<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(folder.Root()))
            names.insert(entry.path().filename().string());
        return names;
    }

    const std::string geobase = folder / "chantier.geo";
    std::vector<std::size_t> written;
    int toleranceBlocks = 0;
};

TEST_F(ListingFlow, NothingWithoutResultsAndNothingAfterNo) {
    Options(false, true, true, 1);
    EXPECT_EQ(WriteComputationListing(frontEnd, Request(ListingKind::Intersection, 0)), "");
    EXPECT_TRUE(frontEnd.questions.empty());

    frontEnd.answers = {ui::Answer::No};
    EXPECT_EQ(WriteComputationListing(frontEnd, Request(ListingKind::StationV0, 2)), "");
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{kListingQuestionV0});
    EXPECT_TRUE(frontEnd.fileChoices.empty());
    EXPECT_TRUE(written.empty());
    EXPECT_EQ(FilesInFolder(), std::set<std::string>{"Pyralis.ini"});
}

TEST_F(ListingFlow, BesideTheGeoBaseWithoutFileChoiceEachResultWithItsHeading) {
    Options(false, false, true, 1);
    const std::string listingPath = WriteComputationListing(frontEnd, Request(ListingKind::Intersection, 2));

    EXPECT_EQ(listingPath, folder / "chantier.cin");
    EXPECT_TRUE(frontEnd.fileChoices.empty());
    EXPECT_TRUE(frontEnd.shownFiles.empty());
    EXPECT_TRUE(frontEnd.lines.empty()) << "no echo while the file is written";
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{kListingQuestionCalculations});
    EXPECT_EQ(written, (std::vector<std::size_t>{0, 1}));
    EXPECT_EQ(toleranceBlocks, 2);

    // Each result on its own numbered page of 30 lines, in this order.
    const std::string text = ReadBytes(listingPath);
    std::size_t at = 0;
    for (const std::string& expected :
         {std::string("PYRALIS CALCULS TOPOMETRIQUES - CALCUL PAR INTERSECTION"),
          "Nom de la GéoBase traitée : " + geobase, std::string("Calculs effectués le      : "),
          std::string("Tolérance angulaire : 0.0100 Gr"), std::string("|  Calcul du point P1  |"),
          std::string("Page 1"), std::string("CALCUL PAR INTERSECTION"), std::string("P2"),
          std::string("Page 2")}) {
        std::size_t found = text.find(expected, at);
        ASSERT_NE(found, std::string::npos) << expected;
        at = found + expected.size();
    }
    EXPECT_NE(text.find("\n" + std::string(80, '#') + "\n#"), std::string::npos);
    EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 60);
}

TEST_F(ListingFlow, ExistingPlainListingIsCompletedOnYesAndReplacedOnNo) {
    Options(false, false, false, 1);
    const std::string listingPath = folder / "chantier.cin";
    WriteBytes(listingPath, "listing d'hier\n");

    frontEnd.answers = {ui::Answer::Yes, ui::Answer::Yes};
    WriteComputationListing(frontEnd, Request(ListingKind::Intersection, 1));
    EXPECT_EQ(frontEnd.questions.back(), Sprintf(kMsgListingExists, listingPath.c_str()));
    const std::string completed = ReadBytes(listingPath);
    EXPECT_EQ(completed.rfind("listing d'hier\n", 0), 0u);
    EXPECT_NE(completed.find("P1"), std::string::npos);
    EXPECT_EQ(toleranceBlocks, 0);

    frontEnd.answers = {ui::Answer::Yes, ui::Answer::No};
    WriteComputationListing(frontEnd, Request(ListingKind::Intersection, 1));
    const std::string replaced = ReadBytes(listingPath);
    EXPECT_EQ(replaced.find("listing d'hier"), std::string::npos);
    EXPECT_EQ(Count(replaced, "CALCUL PAR INTERSECTION"), 1);
    EXPECT_EQ(Count(completed, "CALCUL PAR INTERSECTION"), 1);
}

TEST_F(ListingFlow, RichTextListingIsAlwaysReplacedWithoutAQuestion) {
    Options(false, false, false, 0);
    const std::string listingPath = folder / "chantier.rtf";
    WriteBytes(listingPath, "listing d'hier\n");

    EXPECT_EQ(WriteComputationListing(frontEnd, Request(ListingKind::Resection, 1)), listingPath);
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{kListingQuestionCalculations});
    const std::string rtf = ReadBytes(listingPath);
    EXPECT_EQ(rtf.rfind("{\\rtf1", 0), 0u);
    EXPECT_EQ(rtf.find("listing d'hier"), std::string::npos);
    EXPECT_NE(rtf.find("CALCUL PAR RELEVEMENT"), std::string::npos);
}

TEST_F(ListingFlow, FileChoiceOffersTheDefaultNameWithTheFormsFilter) {
    Options(true, false, false, 1);
    frontEnd.files = {std::optional<std::string>(folder / "autre")};
    EXPECT_EQ(WriteComputationListing(frontEnd, Request(ListingKind::StationV0, 1)), folder / "autre.cv0");
    ASSERT_EQ(frontEnd.fileChoices.size(), 1u);
    const ui::FileChoice& choice = frontEnd.fileChoices[0];
    EXPECT_TRUE(choice.save);
    EXPECT_EQ(choice.title, "Choix du fichier listing");
    EXPECT_EQ(choice.filter, "Listing de calcul de V0 (*.cv0)|*.cv0||");
    EXPECT_EQ(choice.defaultExtension, "cv0");
    EXPECT_EQ(choice.startPath, folder / "chantier.cv0");

    // Cancelling keeps the default name; the recoupement offers its rich text as the intersection's.
    Options(true, false, false, 0);
    frontEnd.files = {std::nullopt};
    EXPECT_EQ(WriteComputationListing(frontEnd, Request(ListingKind::Recoupement, 1)),
              folder / "chantier.rtf");
    EXPECT_EQ(frontEnd.fileChoices.back().filter, "Listing d'intersection (*.rtf)|*.rtf||");
    EXPECT_EQ(frontEnd.fileChoices.back().defaultExtension, "rtf");
}

TEST_F(ListingFlow, ShownWhenAskedAndAskedOnlyWhenNotAlreadyChosen) {
    Options(false, true, false, 2);
    ListingRequest request = Request(ListingKind::EccentricStation, 1);
    request.ask = false;
    const std::string listingPath = WriteComputationListing(frontEnd, request);
    EXPECT_EQ(listingPath, folder / "chantier.cex");
    EXPECT_TRUE(frontEnd.questions.empty());
    EXPECT_EQ(frontEnd.shownFiles, std::vector<std::string>{listingPath});
    EXPECT_EQ(ReadBytes(listingPath).find("Page"), std::string::npos) << "format 2 has no page count";
}

TEST_F(ListingFlow, ListingThatCannotBeOpenedIsSkippedSilently) {
    Options(false, true, false, 1);
    ListingRequest request = Request(ListingKind::Intersection, 1);
    request.geobasePath = folder / "absent/chantier.geo";
    EXPECT_EQ(WriteComputationListing(frontEnd, request), "");
    EXPECT_TRUE(frontEnd.messages.empty());
    EXPECT_TRUE(frontEnd.shownFiles.empty());
    EXPECT_TRUE(written.empty());
}

TEST(ListingKinds, EachKindHasItsOwnExtensionAndAFilterOfThatForm) {
    std::set<std::string> extensions;
    for (int k = 0; k < kListingKindCount; ++k) {
        const ListingKindInfo& info = ListingKindOf(static_cast<ListingKind>(k));
        EXPECT_EQ(info.kind, static_cast<ListingKind>(k)) << "the table follows the enumeration";
        EXPECT_TRUE(extensions.insert(std::string(info.extension)).second) << info.extension;
        EXPECT_TRUE(info.label.ends_with(" (*." + std::string(info.extension) + ")")) << info.label;
    }
    EXPECT_EQ(ListingFilter(ListingKind::RadiatedPoints, false),
              "Listing de points rayonnés (*.cpr)|*.cpr||");
}

} // namespace
} // namespace pyr::test
