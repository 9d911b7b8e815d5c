// The dialog "PYRALIS - Calcul des V0 de stations" driven through its actions, on GéoBases built from
// exact coordinates: the stations oriented, written back, listed and journalled.
#include "TestSupport.h"
#include "calc/CalculV0Sta.h"
#include "core/Files.h"
#include "core/SafeFile.h"
#include "settings/LastGeoBase.h"
#include "settings/ListingKinds.h"
#include "test_v0_geometry.h"
#include "ui/ScriptedFrontEnd.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace pyr::test {
namespace {

const Place kS1{1000.0, 2000.0, 100.0}, kS2{1100.0, 2100.0, 102.0};
// From S1: A at bearing 0 and 100 m, B at 100 and 200 m, C at 300 and 300 m, D at 200 and 100 m.
const std::pair<const char*, Place> kPoints[] = {{"A", {1000.0, 2100.0, 101.0}},
                                                 {"B", {1200.0, 2000.0, 99.2}},
                                                 {"C", {700.0, 2000.0, 104.5}},
                                                 {"D", {1000.0, 1900.0, 100.0}}};

// The listing options of a run without questions of names: plain text in one run, beside the GéoBase.
constexpr const char* kParams =
    "[Options_Listings]\nChoixNomListing=0\nAfficherListing=0\nEcrireTolérances=1\n"
    "[Listings]\nFormat=2\n";

class V0Dialog : public ::testing::Test {
protected:
    V0Dialog() {
        WriteBytes(params, kParams);
        AddPoint(job, "S1", kS1);
        for (const auto& [name, place] : kPoints)
            AddPoint(job, name, place);
    }

    // S1 oriented at 50 gr on A, B and C; D read 0.02 gr off.
    void AddStationS1() {
        AddStation(job, "S1", 1.5, 49.5);
        for (const auto& [name, place] : kPoints)
            AddSighting(job, name, kS1, 1.5, place, 1.3, 50.0);
        job.As<CVisee>(job.GetSize() - 1)->setAH(149.98);
    }
    // S2, not in the GéoBase's points, oriented at 120 gr on A and B.
    void AddStationS2() {
        AddStation(job, "S2", 1.6);
        for (int i : {0, 1})
            AddSighting(job, kPoints[i].first, kS2, 1.6, kPoints[i].second, 1.3, 120.0);
    }

    bool Open() {
        EXPECT_EQ(job.Save(geo), 1);
        dialog.SetInputs({geo, params, "", "calcul du V0 d'une station"});
        return dialog.Open(frontEnd);
    }
    double SavedV0(const char* station, int reprise) const {
        CCarnet carnet;
        carnet.Load(nullptr, geo);
        return carnet.v0At(carnet.findStaRep(station, reprise));
    }
    std::vector<std::string> Messages() const {
        std::vector<std::string> texts;
        for (const auto& message : frontEnd.messages) {
            EXPECT_EQ(message.caption, "PYRALIS");
            EXPECT_EQ(message.icon, ui::kIconWarning);
            texts.push_back(message.text);
        }
        return texts;
    }

    TempDir dir;
    const std::string geo = dir / "chantier.geo";
    const std::string params = dir / "Pyralis.ini";
    CCarnet job;
    ui::ScriptedFrontEnd frontEnd;
    CCalculV0Sta dialog;
};

TEST_F(V0Dialog, OneStationIsOrientedWrittenBackListedAndJournalled) {
    AddStationS1();
    job.As<CPointGen>(job.findMat("B"))->setZ(99.25); // 5 cm off: a warning, and B stays
    ASSERT_TRUE(Open());
    EXPECT_EQ(dialog.V0(), 49.5) << "the GéoBase's V0 until computed";

    ASSERT_TRUE(dialog.Calculate());
    ASSERT_EQ(Messages().size(), 1u);
    EXPECT_NE(Messages()[0].find("dénivelées mesurées et calculées\nvers la référence <B>"),
              std::string::npos);
    ASSERT_TRUE(dialog.Enregistrer());
    frontEnd.answers = {ui::Answer::Yes};
    const std::string listing = dialog.Close(true);

    EXPECT_NEAR(SavedV0("S1", 1), 50.0, 1e-9);
    EXPECT_TRUE(FileExists(dir / "chantier.bak"));
    EXPECT_EQ(ReadLastGeoBase(params), geo);
    const std::string journal = ReadBytes(dir / "chantier.jnl"); // after the date of the entry
    EXPECT_EQ(journal.substr(journal.find(" - ")),
              " - Calcul des V0 de stations\nStation   S1(1) : V0 =  50.00000");
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{kListingQuestionV0});

    // The listing's layout is its writer's; here, the values computed for it: a reference's bearing,
    // distance and partial V0, D without one, its residual against the tolerance of four references.
    ASSERT_EQ(listing, dir / "chantier.cv0");
    const std::string text = ReadBytes(listing);
    for (const char* row :
         {"| A         |   0.00000 | 100.0000 | 350.00000 | 50.00000 | 0.00000 |",
          "| D         | 200.00000 | 100.0000 | 149.98000 |        - |       - |",
          "| Valeur du V0 après calcul pondéré     : 50.00000 |",
          " -> V0 hors tolérance pour la référence <D> !\n    (écart = 0.01714 Gr > 0.00372 Gr)"})
        EXPECT_NE(text.find(row), std::string::npos) << row << "\n" << text;
}

// A listing or a journal that cannot be written does not undo what was saved: each is a failure of the
// command, told with its file and the reason, and the GéoBase keeps its new V0.
TEST_F(V0Dialog, AListingOrAJournalThatCannotBeWrittenIsAFailureAndTheGeoBaseStands) {
    AddStationS1();
    ASSERT_TRUE(Open());
    ASSERT_TRUE(dialog.Calculate());
    ASSERT_TRUE(dialog.Enregistrer());
    // Folders where the listing and the journal go.
    std::filesystem::create_directory(dir / "chantier.cv0");
    std::filesystem::create_directory(dir / "chantier.jnl");
    frontEnd.messages.clear();
    frontEnd.answers = {ui::Answer::Yes};
    EXPECT_EQ(dialog.Close(true), "");
    EXPECT_EQ(Messages(), (std::vector<std::string>{FileWriteFailure(dir / "chantier.cv0", EISDIR),
                                                    FileWriteFailure(dir / "chantier.jnl", EISDIR)}));
    EXPECT_EQ(frontEnd.Failures(), 2);
    EXPECT_NEAR(SavedV0("S1", 1), 50.0, 1e-9);
    EXPECT_EQ(ReadLastGeoBase(params), geo);
}

TEST_F(V0Dialog, ListsAndAllStationsCountThoseThatCannotBeOriented) {
    WriteBytes(params, std::string(kParams) + "[Calcul_V0]\nTypDeCalcul=2\nPonderation=0\n");
    AddStationS1();
    AddStationS2(); // no coordinates
    AddStation(job, "S1", 1.5);
    job.Add(std::make_unique<CReference>("INCONNU", 10.0), kKindReference); // no known point
    AddStationS1();                                                         // S1(3)
    ASSERT_TRUE(Open());
    EXPECT_EQ(dialog.Type(), V0CalculationType::Toutes); // the settings read on opening
    EXPECT_FALSE(dialog.Weighted());
    ASSERT_TRUE(dialog.Calculate());
    EXPECT_EQ(Messages(), std::vector<std::string>{"2 stations de la liste non calculables"});
    EXPECT_NE(frontEnd.AllLines().find("Station S1(2) : Aucune référence valide pour le calcul du V0 !"),
              std::string::npos);

    frontEnd.messages.clear();
    dialog.SetType(V0CalculationType::Liste);
    ASSERT_TRUE(dialog.SetList("S2-S9"));
    EXPECT_FALSE(dialog.Calculate());
    EXPECT_EQ(Messages(), std::vector<std::string>{"1 stations de la liste non calculables"});

    ASSERT_TRUE(dialog.Enregistrer()); // every station computed
    for (int reprise : {1, 2, 3})
        EXPECT_NEAR(SavedV0("S1", reprise), reprise == 2 ? kUndefined : 50.0, 1e-9) << reprise;

    // The settings are kept when the dialog closes with "&Enregistrer", not when it is cancelled.
    dialog.SetWeighted(true);
    dialog.Close(false);
    EXPECT_EQ(ReadBytes(params).find("TypDeCalcul=1"), std::string::npos);
    dialog.Close(true);
    EXPECT_NE(ReadBytes(params).find("TypDeCalcul=1\nPonderation=1"), std::string::npos) << ReadBytes(params);
}

TEST_F(V0Dialog, AStationWithoutCoordinatesTakesThemTypedOrAV0ByHand) {
    AddStationS2();
    AddStationS1();
    ASSERT_TRUE(Open());
    ASSERT_TRUE(dialog.ChooseStation("S2"));
    EXPECT_FALSE(dialog.Calculate());
    EXPECT_EQ(Messages(),
              std::vector<std::string>{"Les coordonnées de la station <S2(1)> ne sont pas connues :\n"
                                       "son V0 ne peut pas être calculé !"});

    // A V0 fixed by hand needs no coordinates; a full turn is 0.
    ASSERT_TRUE(dialog.EnterV0(400.0));
    EXPECT_EQ(dialog.V0(), 0.0);
    EXPECT_FALSE(dialog.EnterV0(-3.0));

    // Typed coordinates orient it from its references and become a point of the GéoBase; those of S1,
    // placed by the GéoBase, are refused.
    ASSERT_TRUE(dialog.ChooseStation("S1"));
    EXPECT_FALSE(dialog.SetStationCoordinates(1.0, 2.0, kUndefined));
    ASSERT_TRUE(dialog.ChooseStation("S2"));
    ASSERT_TRUE(dialog.SetStationCoordinates(kS2.x, kS2.y, kS2.z));
    ASSERT_TRUE(dialog.Calculate()); // saved with its new point: through the window, in test_calc_forms
    EXPECT_NEAR(dialog.V0(), 120.0, 1e-5);
}

} // namespace
} // namespace pyr::test
