#include "SettingsTestSupport.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "settings/ListingFlow.h"

#include <set>

namespace pyr::test {
namespace {

using namespace std::string_literals;

class ListingFlow : public SettingsTest {
protected:
    // Listing options and layout as the parameter file holds them.
    void Options(bool chooseName, bool show, bool tolerances, int format) {
        WriteBytes(path, Sprintf("[Options_Listings]\nChoixNomListing=%d\nAfficherListing=%d\n"
                                 "EcrireTolérances=%d\n[Listings]\nFormat=%d\nLongueurPage=30\n",
                                 chooseName, show, tolerances, format));
    }

    // Each result writes its point's name; the tolerances, a line of their own.
    std::string Write(ListingKind kind, std::size_t results, bool ask = true, std::string named = {}) {
        auto result = [](CDlgCfgListing& listing, std::size_t i) { listing.WriteLine("P%zu\n", i + 1); };
        auto tolerances = [](CDlgCfgListing& listing) { listing.WriteLine("Tolérance : 0.0100 Gr\n"); };
        return WriteComputationListing(frontEnd,
                                       {path, geobase, kind, results, result, tolerances, ask, named});
    }

    std::string geobase = folder / "chantier.geo";
};

TEST_F(ListingFlow, NothingWithoutResultsOrAfterNo) {
    Options(false, true, true, 1);
    EXPECT_EQ(Write(ListingKind::Intersection, 0), "");
    EXPECT_TRUE(frontEnd.questions.empty());

    frontEnd.answers = {ui::Answer::No};
    EXPECT_EQ(Write(ListingKind::StationV0, 2), "");
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{kListingQuestionV0});
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.Root()), {}), 1) << "Pyralis.ini only";
    EXPECT_TRUE(frontEnd.messages.empty());
}

// A listing that cannot be written is a failure of the command, told with its file and the reason; the
// listing that was there before stays whole, whether the new one was to complete it or replace it.
TEST_F(ListingFlow, AListingThatCannotBeWrittenIsReportedAndLeavesTheOldOneWhole) {
    Options(false, true, true, 1);
    geobase = folder / "absent/chantier.geo";
    EXPECT_EQ(Write(ListingKind::Intersection, 1, false), "");
    EXPECT_EQ(frontEnd.Failures(), 1);
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text, FileWriteFailure(folder / "absent/chantier.cin", ENOENT));
    EXPECT_TRUE(frontEnd.shownFiles.empty());

    // Past the size a file may reach, as on a full disk: a page of the listing does not fit.
    geobase = folder / "chantier.geo";
    const std::string listingPath = folder / "chantier.cin";
    const std::string yesterday = "listing d'hier\n";
    // The format, and the answer to "complete the listing?".
    for (const auto& [format, answer] :
         {std::pair{1, ui::Answer::Yes}, {1, ui::Answer::No}, {0, ui::Answer::Yes}}) {
        Options(false, true, true, format);
        const std::string target = format == 0 ? folder / "chantier.rtf" : listingPath;
        WriteBytes(target, yesterday);
        const int status = InChildWithFileSizeLimit(600, [&] {
            frontEnd.ResetFailures();
            frontEnd.messages.clear();
            frontEnd.answers = {answer};
            const bool reported = Write(ListingKind::Intersection, 3, false).empty() &&
                                  frontEnd.Failures() == 1 && frontEnd.shownFiles.empty() &&
                                  frontEnd.messages.back().text == FileWriteFailure(target, EFBIG);
            return reported ? 0 : 1;
        });
        EXPECT_EQ(status, 0) << "format " << format << ": not failed, or not reported";
        EXPECT_EQ(ReadBytes(target), yesterday) << "format " << format;
        std::filesystem::remove(target);
    }
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.Root()), {}), 1) << "no copy left";
}

TEST_F(ListingFlow, BesideTheGeoBaseWithoutFileChoiceEachResultOnItsOwnPage) {
    Options(false, false, true, 1);
    const std::string listingPath = Write(ListingKind::Intersection, 2);
    EXPECT_EQ(listingPath, folder / "chantier.cin");
    EXPECT_TRUE(frontEnd.fileChoices.empty());
    EXPECT_TRUE(frontEnd.shownFiles.empty());
    EXPECT_TRUE(frontEnd.lines.empty()) << "no echo while the file is written";

    const std::string text = ReadBytes(listingPath);
    std::size_t at = 0;
    for (const std::string& expected :
         {"TOPOMETRIQUES - CALCUL PAR INTERSECTION"s, "Nom de la GéoBase traitée : " + geobase,
          "Calculs effectués le      : "s, "Tolérance"s, "P1"s, "Page 1"s, "P2"s, "Page 2"s}) {
        at = text.find(expected, at);
        ASSERT_NE(at, std::string::npos) << expected;
    }
    EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 60) << "two pages of 30 lines";
}

TEST_F(ListingFlow, ExistingPlainListingIsCompletedOnYesAndReplacedOnNo) {
    Options(false, false, false, 1);
    const std::string listingPath = folder / "chantier.cin";
    WriteBytes(listingPath, "listing d'hier\n");

    Write(ListingKind::Intersection, 1); // Yes to both questions
    EXPECT_EQ(frontEnd.questions.back(), Sprintf(kMsgListingExists, listingPath.c_str()));
    const std::string completed = ReadBytes(listingPath);
    EXPECT_EQ(completed.rfind("listing d'hier\nPYRALIS Calculs Topo", 0), 0u);
    EXPECT_EQ(completed.find("Tolérance"), std::string::npos) << "EcrireTolérances=0";

    frontEnd.answers = {ui::Answer::Yes, ui::Answer::No};
    Write(ListingKind::Intersection, 1);
    EXPECT_EQ(ReadBytes(listingPath).rfind("PYRALIS Calculs Topo", 0), 0u);
}

TEST_F(ListingFlow, FileChoiceOffersTheDefaultNameWithTheFormsFilter) {
    Options(true, false, false, 1);
    frontEnd.files = {std::optional<std::string>(folder / "autre")};
    EXPECT_EQ(Write(ListingKind::StationV0, 1), folder / "autre.cv0");
    ASSERT_EQ(frontEnd.fileChoices.size(), 1u);
    EXPECT_TRUE(frontEnd.fileChoices[0].save);
    EXPECT_EQ(frontEnd.fileChoices[0].filter, "Listing de calcul de V0 (*.cv0)|*.cv0||");
    EXPECT_EQ(frontEnd.fileChoices[0].startPath, folder / "chantier.cv0");

    // A file named in advance is taken as it is, without the choice.
    EXPECT_EQ(Write(ListingKind::StationV0, 1, false, folder / "nommé"), folder / "nommé.cv0");
    EXPECT_EQ(frontEnd.fileChoices.size(), 1u);
}

TEST_F(ListingFlow, RichTextListingIsAlwaysReplacedWithoutAQuestion) {
    // A cancelled choice keeps the default name; the recoupement's rich text is under the intersection's.
    Options(true, false, false, 0);
    frontEnd.files = {std::nullopt};
    WriteBytes(folder / "chantier.rtf", "listing d'hier\n");
    EXPECT_EQ(Write(ListingKind::Recoupement, 1), folder / "chantier.rtf");
    EXPECT_EQ(frontEnd.fileChoices.back().filter, "Listing d'intersection (*.rtf)|*.rtf||");
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{kListingQuestionCalculations});
    EXPECT_EQ(ReadBytes(folder / "chantier.rtf").rfind("{\\rtf1", 0), 0u);
}

TEST_F(ListingFlow, ShownWhenAskedWithoutAQuestionWhenAlreadyChosen) {
    Options(false, true, false, 2);
    const std::string listingPath = Write(ListingKind::EccentricStation, 1, false);
    EXPECT_TRUE(frontEnd.questions.empty());
    EXPECT_EQ(frontEnd.shownFiles, std::vector<std::string>{listingPath});
    EXPECT_EQ(ReadBytes(listingPath).find("Page"), std::string::npos) << "format 2 has no page count";
}

TEST(ListingKinds, EachKindHasItsOwnEntryAndExtension) {
    std::set<std::string> extensions;
    for (int k = 0; k < kListingKindCount; ++k) {
        const ListingKindInfo& info = ListingKindOf(static_cast<ListingKind>(k));
        EXPECT_EQ(info.kind, static_cast<ListingKind>(k)) << "the table follows the enumeration";
        EXPECT_TRUE(extensions.insert(std::string(info.extension)).second) << info.extension;
    }
}

} // namespace
} // namespace pyr::test
