// The calculation options: the typed reads with their defaults and limits, the options sheet with its
// pages (read, OK, Cancel), the store's decimals and axis order, and the sheet's command line.
#include "SettingsTestSupport.h"
#include "geobase/Elements.h"
#include "settings/CalcOptions.h"
#include "settings/OptionPages.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace pyr {
namespace {

using Words = std::vector<std::string>;

class CalcOptions : public test::SettingsTest {
protected:
    // The store's settings are class-wide: every test leaves them as a fresh program has them.
    ~CalcOptions() override {
        SetStoreDecimals(4, 3, 5);
        CPointGen::setSwapXY(false);
    }

    COptionPSheet Sheet() const {
        COptionPSheet sheet;
        sheet.SetInputs({"", path, "", "options des calculs topométriques."});
        return sheet;
    }

    // Runs the sheet as the command does, with those words as its command line; gives the refusals.
    Words RunSheet(const Words& words, ui::DialogResult expected) {
        frontEnd.messages.clear();
        frontEnd.lines.clear();
        frontEnd.dialogArguments = words;
        frontEnd.command = "CalcOpt";
        COptionPSheet sheet = Sheet();
        EXPECT_EQ(frontEnd.DoModal(sheet), expected);
        return Texts(frontEnd, ui::kIconWarning);
    }

    bool Shown(const std::string& line) const {
        return std::find(frontEnd.lines.begin(), frontEnd.lines.end(), line) != frontEnd.lines.end();
    }
};

TEST_F(CalcOptions, ReadsGiveTheDefaultsAndHoldValuesWithinTheirLimits) {
    // A default outside its limits would be changed by every read.
    for (const auto& entry : CalcOptionTable()) {
        if (entry.type == OptionType::Text) continue;
        const double byDefault = std::stod(std::string(entry.defaultValue));
        EXPECT_TRUE(byDefault >= entry.minimum && byDefault <= entry.maximum) << entry.key;
        EXPECT_EQ(ReadOptionReal(path, entry.section, entry.key), byDefault) << entry.key;
    }
    EXPECT_EQ(ReadOptionReal(path, kSectionDatabase, "Tolérance"), 0.001); // a text holding a real
    EXPECT_EQ(ReadOptionText(path, kSectionListings, "RayonContenu"), "N,X,Y,Z,GI,DH");
    // A caller's slip reads as nothing rather than as another key's value.
    EXPECT_EQ(ReadOptionInt(path, kSectionTolerances, "TypeNivel"), 0);
    EXPECT_EQ(ReadOptionText(path, "Options_Inconnues", "Projection"), "");

    EXPECT_EQ(Sheet().LinkDB().Text("Ident_Mat"), "NUMERO");
    EXPECT_FALSE(std::filesystem::exists(path)); // reading creates nothing

    // Values outside their limits come back clamped.
    WriteBytes(path, "[Options_Corrections]\nRayonTerre=5000\n[Options_Calculs]\nGeneral=9\nIntersAvecHp=5\n"
                     "[Options_Nivellement]\nTypeNivel=-3\n");
    EXPECT_EQ(ReadOptionReal(path, kSectionCorrections, "RayonTerre"), 6000);
    EXPECT_EQ(ReadOptionInt(path, kSectionCalculations, "General"), 7);
    EXPECT_EQ(ReadOptionInt(path, kSectionCalculations, "IntersAvecHp"), 1);
    EXPECT_EQ(ReadOptionInt(path, kSectionLevelling, "TypeNivel"), 0);

    COptionPSheet sheet = Sheet();
    sheet.Correct().SetReal("RayonTerre", 8000); // a widget's value is held within the limits too
    EXPECT_EQ(sheet.Correct().Real("RayonTerre"), 7000);
}

TEST_F(CalcOptions, TheStoreTakesItsDecimalsAndAxisOrderFromTheOptions) {
    // Texts that are not plain numbers: the leading integer, kept within 0 to 10, else the default.
    WriteBytes(path, "[Options_Editeur]\nNombreDecimaleXY= 3 décimales\nNombreDecimaleZ=25\n"
                     "NombreDecimaleAng=beaucoup\n[Options_Listings]\nInverser_XY=1\n");
    SetStoreDecimals(0, 0, 0);
    ApplyStoreOptions(path);
    EXPECT_EQ(CPointGen::DeciXY(), 3);
    EXPECT_EQ(CPointGen::DeciZ(), 10);
    EXPECT_EQ(CStation::DeciAng(), 5);
    EXPECT_TRUE(CPointGen::SwapXY());

    // Reading the sheet applies the file; its OK applies what it writes.
    SetStoreDecimals(0, 0, 0);
    COptionPSheet sheet = Sheet();
    sheet.Pages();
    EXPECT_EQ(CPointGen::DeciXY(), 3);
    sheet.Editor().SetText("NombreDecimaleXY", "1");
    sheet.Listing().SetSwitch("Inverser_XY", false);
    ASSERT_TRUE(sheet.OnOK());
    EXPECT_EQ(CReference::DeciXY(), 1);
    EXPECT_FALSE(CPointGen::SwapXY());
}

TEST_F(CalcOptions, OkWritesEveryKeyInItsFormatAndCancelWritesNothing) {
    const std::string handKept =
        "; réglages du cabinet\n[Options_Nivellement]\nTypeTolerance=2\nFermAltimetr=0.05\n"
        "[Options_Tolerances]\nTypeTolerance=1\nFermAltimetr=0.2\n";
    WriteBytes(path, handKept);
    {
        COptionPSheet sheet = Sheet();
        sheet.Correct().SetReal("RayonTerre", 6378.5);
        sheet.Listing().AddRadiatedColumn(CPagOptionListing::kExtraColumns[0]);
        sheet.OnCancel();
    }
    EXPECT_EQ(ReadBytes(path), handKept);

    COptionPSheet sheet = Sheet();
    sheet.Correct().SetReal("RayonTerre", 6378.5);
    sheet.Listing().AddRadiatedColumn("HP");
    sheet.LinkDB().SetText("NomTableDonnées", "Points levés");
    sheet.Nivel().SetInt("TypeTolerance", 0);
    sheet.Toler().SetReal("FermAltimetr", 0.3);
    ASSERT_TRUE(sheet.OnOK());
    const std::string written = ReadBytes(path);
    for (const char* line :
         {"; réglages du cabinet", "RayonTerre=6378.500000", "General=7", "IntersAvecHp=1",
          "NombreDecimaleXY=4", "RayonContenu=N,X,Y,Z,GI,DH,HP", "Tolérance=0.001",
          "NomTableDonnées=Points levés", "Appareil0=Appareil Standard", "SigmaPpm0=0.000000"})
        EXPECT_NE(written.find(std::string(line) + "\n"), std::string::npos) << line << "\n" << written;
    EXPECT_EQ(Sheet().Lines(), sheet.Lines()); // what OK wrote reads back as the sheet held it

    // Levelling and tolerances each keep their keys of the same name.
    EXPECT_EQ(ReadOptionInt(path, kSectionLevelling, "TypeTolerance"), 0);
    EXPECT_EQ(ReadOptionInt(path, kSectionTolerances, "TypeTolerance"), 1);
    EXPECT_EQ(ReadOptionReal(path, kSectionLevelling, "FermAltimetr"), 0.05);
    EXPECT_EQ(ReadOptionReal(path, kSectionTolerances, "FermAltimetr"), 0.3);
}

TEST_F(CalcOptions, TheStandardInstrumentIsAlwaysOfferedFirst) {
    EXPECT_EQ(ReadInstruments(path), std::vector<InstrumentOptions>{{kStandardInstrument}});

    // The file numbers its instruments as it likes; the list stops at the first missing name.
    WriteBytes(path, "[Définitions_Des_Appareils]\nAppareil0=TC 1800\nSigmaAh0=0.0003\nSigmaDi0=5\n"
                     "Appareil1=Appareil Standard\nSigmaPpm1=2\nAppareil3=Perdu\n");
    EXPECT_EQ(ReadInstruments(path),
              (std::vector<InstrumentOptions>{{kStandardInstrument, 0, 0, 0, 0, 0, 2},
                                              {"TC 1800", 0, 0, 0.0003, 0, 1, 0}})); // 1 m at most

    COptionPSheet sheet = Sheet();
    CPagOptionAppareil& page = sheet.Appareil();
    EXPECT_FALSE(page.RemoveInstrument(0));
    EXPECT_EQ(page.AddInstrument(" "), -1);
    ASSERT_EQ(page.AddInstrument("DI 2002"), 2);
    page.SetInstrument(2, {"DI 2002", 0.0175, 0, 0.001, 0.001, 0.001, 1});
    ASSERT_TRUE(sheet.OnOK());
    EXPECT_EQ(ReadInstruments(path), page.Instruments());
    EXPECT_NE(ReadBytes(path).find("Appareil0=Appareil Standard\n"), std::string::npos);

    // A removed instrument is not read back from what it left in the file.
    COptionPSheet fewer = Sheet();
    ASSERT_TRUE(fewer.Appareil().RemoveInstrument(1));
    ASSERT_TRUE(fewer.OnOK());
    EXPECT_EQ(ReadInstruments(path), fewer.Appareil().Instruments());
}

TEST_F(CalcOptions, ACommandLineSettingWritesOnlyItsKey) {
    WriteBytes(path, "[Options_Corrections]\nProjection=CC48\nRayonTerre=6366\nCorrAuto=1\n\n"
                     "[Options_Listings]\nAfficherListing=0\n");
    EXPECT_EQ(
        RunSheet({"--regler", "Options_Corrections/RayonTerre=6378", "--regler",
                  "options_listings/inverser_xy=1", "--regler", "Options_Corrections/RayonTerre=6378.25"},
                 ui::DialogResult::Ok),
        Words{});
    EXPECT_EQ(ReadBytes(path),
              "[Options_Corrections]\nProjection=CC48\nRayonTerre=6378.250000\nCorrAuto=1\n\n"
              "[Options_Listings]\nAfficherListing=0\nInverser_XY=1\n");
    EXPECT_EQ(frontEnd.lines, (Words{"Option réglée : Options_Corrections/RayonTerre=6378.250000",
                                     "Option réglée : Options_Listings/Inverser_XY=1"}));
    EXPECT_TRUE(CPointGen::SwapXY());

    // Instruments are named, then set, one number after the last.
    RunSheet({"--regler", "Définitions_Des_Appareils/Appareil1=TC 1800", "--regler",
              "Définitions_Des_Appareils/SigmaAh1=0.0003"},
             ui::DialogResult::Ok);
    EXPECT_EQ(ReadInstruments(path),
              (std::vector<InstrumentOptions>{{kStandardInstrument}, {"TC 1800", 0, 0, 0.0003}}));
}

TEST_F(CalcOptions, ACommandLineSettingRefusedWritesNothingAndSaysWhy) {
    const std::string before = "[Options_Nivellement]\nTypeNivel=2\n";
    WriteBytes(path, before);
    const std::pair<std::string, std::string> cases[] = {
        {"Options_Corrections/RayonTerre=5000",
         "Options_Corrections/RayonTerre : la valeur 5000 est hors des limites (6000 à 7000)."},
        {"Options_Corrections/RayonTerre=6378,5",
         "Options_Corrections/RayonTerre : la valeur « 6378,5 » n'est pas un nombre."},
        {"Options_Calculs/General=2.5",
         "Options_Calculs/General : la valeur « 2.5 » n'est pas un nombre entier."},
        {"Options_Listings/Inverser_XY=oui",
         "Options_Listings/Inverser_XY : la valeur « oui » doit être 0 ou 1."},
        {"Options_Inconnues/RayonTerre=6378", "Options_Inconnues : section d'options inconnue."},
        {"Options_Corrections/Rayon=6378", "Options_Corrections/Rayon : clé inconnue dans cette section."},
        {"Définitions_Des_Appareils/SigmaAh3=0.001", "Définitions_Des_Appareils/SigmaAh3 : pas d'appareil "
                                                     "n°3 (les appareils de la liste vont de 0 à 0)."},
        {"Définitions_Des_Appareils/Appareil0=TC 1800",
         "Définitions_Des_Appareils/Appareil0 : l'appareil n°0 reste « Appareil Standard »."},
        {"Définitions_Des_Appareils/SigmaAh1=0.0003", "Définitions_Des_Appareils/SigmaAh1 : un nouvel "
                                                      "appareil se déclare d'abord par son nom, Appareil1."},
        {"Définitions_Des_Appareils/Appareil2=DI 2002",
         "Définitions_Des_Appareils/Appareil2 : un nouvel "
         "appareil prend le numéro 1, celui qui suit le dernier de la liste."},
        {"RayonTerre=6378", "« RayonTerre=6378 » : réglage mal écrit, il faut Section/Clé=valeur "
                            "(par exemple Options_Corrections/RayonTerre=6378)."},
    };
    for (const auto& [setting, reason] : cases) {
        // A setting accepted before the refused one is not written either.
        EXPECT_EQ(RunSheet({"--regler", "Options_Nivellement/TypeNivel=1", "--regler", setting, "--afficher"},
                           ui::DialogResult::Failed),
                  Words{reason});
        EXPECT_EQ(ReadBytes(path), before) << setting;
        EXPECT_TRUE(frontEnd.lines.empty()) << setting;
    }
}

TEST_F(CalcOptions, TheValuesAreShownAsAnInitialisationFileShowsThem) {
    WriteBytes(path,
               "[Options_Corrections]\nRayonTerre=6378\n[Définitions_Des_Appareils]\nAppareil1=TC 1800\n");
    RunSheet({"--afficher"}, ui::DialogResult::Ok);
    const Words shown = frontEnd.lines;
    Words sections;
    std::string copy;
    for (std::size_t i = 0; i < shown.size(); ++i) {
        copy += shown[i] + "\n";
        if (shown[i].empty()) { // an empty line only before a section
            EXPECT_TRUE(i + 1 < shown.size() && shown[i + 1].front() == '[') << i;
        } else if (shown[i].front() == '[') {
            sections.push_back(shown[i]);
        } else {
            EXPECT_NE(shown[i].find('='), std::string::npos) << shown[i];
        }
    }
    EXPECT_EQ(sections, (Words{"[Définitions_Des_Appareils]", "[Options_Calculs]", "[Options_Corrections]",
                               "[Options_Editeur]", "[Liaison_Base_de_Données]", "[Options_Listings]",
                               "[Options_Nivellement]", "[Options_Tolerances]"}));
    for (const char* line :
         {"Appareil0=Appareil Standard", "Appareil1=TC 1800", "SigmaPpm1=0.000000", "RayonTerre=6378.000000",
          "General=7", "Projection=Aucune", "NombreDecimaleXY=4"})
        EXPECT_TRUE(Shown(line)) << line;

    // Saved as a file, what is shown gives the same options; alone, the command shows them too.
    WriteBytes(path, copy);
    RunSheet({}, ui::DialogResult::Ok);
    EXPECT_EQ(frontEnd.lines, shown);

    // Settings first, then the values with the new one.
    RunSheet({"--afficher", "--regler", "Options_Tolerances/TolAngles=0.005"}, ui::DialogResult::Ok);
    EXPECT_EQ(frontEnd.lines.at(0), "Option réglée : Options_Tolerances/TolAngles=0.005000");
    EXPECT_EQ(frontEnd.lines.at(1), "");
    EXPECT_TRUE(Shown("TolAngles=0.005000"));
}

} // namespace
} // namespace pyr
