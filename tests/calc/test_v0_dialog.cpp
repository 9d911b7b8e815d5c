// The dialog "PYRALIS - Calcul des V0 de stations" driven through its actions, on GéoBases built from
// exact coordinates: the stations oriented, written back, listed and journalled.
#include "TestSupport.h"
#include "calc/CalculV0Sta.h"
#include "calc/CalculV0Texts.h"
#include "core/Files.h"
#include "settings/LastGeoBase.h"
#include "settings/ListingKinds.h"
#include "test_v0_geometry.h"
#include "ui/ScriptedFrontEnd.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <regex>

namespace pyr::test {
namespace {

using ui::Answer;

const Place kS1{1000.0, 2000.0, 100.0};
const Place kA{1000.0, 2100.0, 101.0}; // from S1: bearing 0, 100 m
const Place kB{1200.0, 2000.0, 99.2};  // bearing 100, 200 m
const Place kC{700.0, 2000.0, 104.5};  // bearing 300, 300 m
const Place kD{1000.0, 1900.0, 100.0}; // bearing 200, 100 m
const Place kS2{1100.0, 2100.0, 102.0};

// The listing options of a run without questions of names: plain text in one run, beside the GéoBase.
constexpr const char* kParams =
    "[Options_Listings]\nChoixNomListing=0\nAfficherListing=0\nEcrireTolérances=1\n"
    "[Listings]\nFormat=2\n";

class V0Dialog : public ::testing::Test {
protected:
    V0Dialog() {
        WriteBytes(params, kParams);
        for (const auto& [name, place] : {std::pair{"S1", kS1}, {"A", kA}, {"B", kB}, {"C", kC}, {"D", kD}})
            AddPoint(job, name, place);
    }

    // S1 oriented at 50 gr on A, B and C; D read 0.02 gr off.
    void AddStationS1(double previousV0 = 49.5) {
        AddStation(job, "S1", 1.5, previousV0);
        for (const auto& [name, place] : {std::pair{"A", kA}, {"B", kB}, {"C", kC}})
            AddSighting(job, name, kS1, 1.5, place, 1.3, 50.0);
        const int d = AddSighting(job, "D", kS1, 1.5, kD, 1.3, 50.0);
        job.As<CVisee>(d)->setAH(149.98);
    }
    // S2, not in the GéoBase's points, oriented at 120 gr on A and B.
    void AddStationS2() {
        AddStation(job, "S2", 1.6);
        for (const auto& [name, place] : {std::pair{"A", kA}, {"B", kB}})
            AddSighting(job, name, kS2, 1.6, place, 1.3, 120.0);
    }

    bool Open() {
        EXPECT_EQ(job.Save(geo), 1);
        dialog.SetInputs({geo, params, "", "calcul du V0 d'une station"});
        return dialog.Open(frontEnd);
    }
    CCarnet Saved() const {
        CCarnet carnet;
        carnet.Load(nullptr, geo);
        return carnet;
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

// The date of a listing or a journal, which changes from run to run.
std::string MaskDates(const std::string& text) {
    static const std::regex date(R"([a-z]+ \d\d [a-zéû]+ \d{4} à \d\d h \d\d mn)");
    return std::regex_replace(text, date, "<date>");
}

TEST_F(V0Dialog, SettingsAreReadOnOpeningAndKeptWhenSaved) {
    WriteBytes(params, std::string(kParams) + "[Calcul_V0]\nTypDeCalcul=2\nPonderation=0\n");
    AddStationS1();
    ASSERT_TRUE(Open());
    EXPECT_EQ(dialog.Type(), V0CalculationType::Toutes);
    EXPECT_FALSE(dialog.Weighted());
    dialog.SetType(V0CalculationType::Liste);
    dialog.SetWeighted(true);
    dialog.Close(false);
    EXPECT_EQ(ReadBytes(params).find("TypDeCalcul=1"), std::string::npos) << "cancelled: nothing kept";
    dialog.Close(true);
    EXPECT_NE(ReadBytes(params).find("TypDeCalcul=1\nPonderation=1"), std::string::npos) << ReadBytes(params);
}

TEST_F(V0Dialog, OneStationIsOrientedWrittenBackListedAndJournalled) {
    AddStationS1();
    ASSERT_TRUE(Open());
    EXPECT_EQ(dialog.Station().Designation(), "S1(1)");
    ASSERT_EQ(dialog.References().size(), 4u);
    EXPECT_TRUE(dialog.References()[3].chosen);
    EXPECT_EQ(dialog.V0(), 49.5) << "the GéoBase's V0 until computed";

    ASSERT_TRUE(dialog.Calculate());
    EXPECT_NEAR(dialog.V0(), 50.0, 1e-5);
    EXPECT_TRUE(Messages().empty());
    ASSERT_TRUE(dialog.Enregistrer());
    frontEnd.answers = {Answer::Yes};
    const std::string listing = dialog.Close(true);

    EXPECT_NEAR(Saved().v0At(Saved().findStaRep("S1", 1)), 50.0, 1e-9);
    EXPECT_TRUE(FileExists(dir / "chantier.bak"));
    EXPECT_EQ(ReadLastGeoBase(params), geo);
    EXPECT_EQ(MaskDates(ReadBytes(dir / "chantier.jnl")),
              "\n\n<date> - Calcul des V0 de stations\nStation   S1(1) : V0 =  50.00000");
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{kListingQuestionV0});

    ASSERT_EQ(listing, dir / "chantier.cv0");
    EXPECT_EQ(MaskDates(ReadBytes(listing)),
              "PYRALIS Calculs Topo                                                chantier.cv0\n"
              "--------------------------------------------------------------------------------\n"
              "\n"
              "\n"
              "################################################################################\n"
              "#          PYRALIS CALCULS TOPOMETRIQUES - CALCUL DES V0 DE STATIONS           #\n"
              "################################################################################\n"
              "Nom de la GéoBase traitée : " +
                  geo +
                  "\n"
                  "Calculs effectués le      : <date>\n"
                  "Tolérances normales :\n"
                  "  V0 sur n références : 0.0043 Gr x racine((n - 1) / n)\n"
                  "  distances           : (3 + D / 1000) cm\n"
                  "  dénivelées          : 0.01 x racine((d + 3)² sin²z + 80 d² cos²z + d⁴ / 1 + 4) m, d = D "
                  "/ 1000\n"
                  "Options : pondération par les distances : oui ; références choisies forcées : non\n"
                  "\n"
                  "| Calcul de la station S1, reprise 1 |\n"
                  "\n"
                  "Coordonnées des points d'appui\n"
                  "------------------------------\n"
                  "|           | Matricule       |     X     |     Y     |    Z    |\n"
                  "| Station   | S1              | 1000.0000 | 2000.0000 | 100.000 |\n"
                  "| Référence | A               | 1000.0000 | 2100.0000 | 101.000 |\n"
                  "| Référence | B               | 1200.0000 | 2000.0000 |  99.200 |\n"
                  "| Référence | C               |  700.0000 | 2000.0000 | 104.500 |\n"
                  "| Référence | D               | 1000.0000 | 1900.0000 | 100.000 |\n"
                  "\n"
                  "| Valeur précédente du V0 = 49.50000 |\n"
                  "\n"
                  "Calcul du V0 de la station (tolérance = 0.00351 Gr)\n"
                  "---------------------------------------------------\n"
                  "| Référence |   Gis.    |    DH    |    AH     |    V0    | eV0 Gr  |\n"
                  "| A         |   0.00000 | 100.0000 | 350.00000 | 50.00000 | 0.00000 |\n"
                  "| B         | 100.00000 | 200.0000 |  50.00000 | 50.00000 | 0.00000 |\n"
                  "| C         | 300.00000 | 300.0000 | 250.00000 | 50.00000 | 0.00000 |\n"
                  "| D         | 200.00000 | 100.0000 | 149.98000 |        - |       - |\n"
                  "\n"
                  "| Valeur du V0 avant calcul             : 49.50000 |\n"
                  "| Valeur du V0 après calcul pondéré     : 50.00000 |\n"
                  "\n"
                  "| Remarques |\n"
                  " -> V0 hors tolérance pour la référence <D> !\n"
                  "    (écart = 0.01714 Gr > 0.00372 Gr)\n"
                  "--------------------------------------------------------------------------------\n");
}

TEST_F(V0Dialog, ListsAndAllStationsCountThoseThatCannotBeOriented) {
    AddStationS1();
    AddStationS2(); // no coordinates
    AddStation(job, "S1", 1.5);
    job.Add(std::make_unique<CReference>("INCONNU", 10.0), kKindReference); // no known point
    AddStationS1();                                                         // S1(3)
    ASSERT_TRUE(Open());

    dialog.SetType(V0CalculationType::Toutes);
    ASSERT_TRUE(dialog.Calculate());
    EXPECT_EQ(dialog.Results().size(), 2u);
    EXPECT_EQ(dialog.NotComputable(), 2);
    EXPECT_EQ(Messages(), std::vector<std::string>{"2 stations de la liste non calculables"});
    EXPECT_NE(frontEnd.AllLines().find("Station S1(2) : Aucune référence valide pour le calcul du V0 !"),
              std::string::npos);

    frontEnd.messages.clear();
    dialog.SetType(V0CalculationType::Liste);
    ASSERT_TRUE(dialog.SetList("S2-S9"));
    EXPECT_FALSE(dialog.Calculate());
    EXPECT_EQ(Messages(), std::vector<std::string>{"1 stations de la liste non calculables"});
    EXPECT_FALSE(dialog.SetList("S9-S2"));
    EXPECT_EQ(Messages().back(), "La liste de sélection des points n'est pas correcte !");

    // Every computed station is written, each once.
    ASSERT_TRUE(dialog.Enregistrer());
    const CCarnet saved = Saved();
    EXPECT_NEAR(saved.v0At(saved.findStaRep("S1", 1)), 50.0, 1e-9);
    EXPECT_EQ(saved.v0At(saved.findStaRep("S1", 2)), kUndefined);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("S1", 3)), 50.0, 1e-9);
}

TEST_F(V0Dialog, AStationWithoutCoordinatesTakesThemTypedOrAV0ByHand) {
    AddStationS2();
    AddStationS1();
    ASSERT_TRUE(Open());
    ASSERT_TRUE(dialog.ChooseStation("S2"));
    EXPECT_EQ(dialog.References().size(), 2u);
    EXPECT_FALSE(dialog.Calculate());
    EXPECT_EQ(Messages(),
              std::vector<std::string>{"Les coordonnées de la station <S2(1)> ne sont pas connues :\n"
                                       "son V0 ne peut pas être calculé !"});

    // A V0 fixed by hand needs no coordinates; a full turn is 0.
    ASSERT_TRUE(dialog.EnterV0(400.0));
    EXPECT_EQ(dialog.V0(), 0.0);
    EXPECT_FALSE(dialog.EnterV0(-3.0));

    // Typed coordinates orient it from its references, and may become a point of the GéoBase.
    ASSERT_TRUE(dialog.SetStationCoordinates(kS2.x, kS2.y, kS2.z));
    ASSERT_TRUE(dialog.Calculate());
    EXPECT_NEAR(dialog.V0(), 120.0, 1e-5);
    EXPECT_FALSE(dialog.ChooseStation("S7"));
    ASSERT_TRUE(dialog.ChooseStation("S1"));
    EXPECT_FALSE(dialog.SetStationCoordinates(1.0, 2.0, kUndefined)) << "S1 is placed by the GéoBase";
    ASSERT_TRUE(dialog.ChooseStation("S2"));
    ASSERT_TRUE(dialog.SetStationCoordinates(kS2.x, kS2.y, kS2.z));
    ASSERT_TRUE(dialog.ChooseReferences("A"));
    ASSERT_TRUE(dialog.Calculate());
    EXPECT_EQ(dialog.StationResult()->references.size(), 1u);

    frontEnd.answers = {Answer::Yes};
    ASSERT_TRUE(dialog.Enregistrer());
    EXPECT_EQ(frontEnd.questions.back(),
              "Voulez-vous ajouter dans la GéoBase le point 3D\ndéfinissant les coordonnées de la station ?");
    const CCarnet saved = Saved();
    double x = 0, y = 0, z = 0;
    ASSERT_TRUE(saved.hasXY("S2", x, y));
    ASSERT_TRUE(saved.hasZ("S2", z));
    EXPECT_EQ(x, kS2.x);
    EXPECT_EQ(z, kS2.z);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("S2", 1)), 120.0, 1e-5);
}

TEST_F(V0Dialog, OutOfToleranceMeasurementsAreShownAsWarnings) {
    AddStationS1();
    job.As<CPointGen>(job.findMat("B"))->setZ(99.25);
    ASSERT_TRUE(Open());
    ASSERT_TRUE(dialog.ChooseReferences("A B C"));
    ASSERT_TRUE(dialog.Calculate());
    ASSERT_EQ(Messages().size(), 1u);
    EXPECT_EQ(
        Messages()[0].rfind("L'écart entre les dénivelées mesurées et calculées\nvers la référence <B>", 0),
        0u);
    EXPECT_EQ(dialog.StationResult()->used, 3);
}

} // namespace
} // namespace pyr::test
