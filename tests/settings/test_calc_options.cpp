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

    // Runs the sheet as the command does, with those words as its command line.
    ui::DialogResult RunSheet(const Words& words) {
        COptionPSheet sheet = Sheet();
        frontEnd.dialogArguments = words;
        frontEnd.command = "CalcOpt";
        return frontEnd.DoModal(sheet);
    }

    std::vector<std::string> Refusals() const {
        std::vector<std::string> texts;
        for (const auto& message : frontEnd.messages)
            texts.push_back(message.text);
        return texts;
    }
};

bool Has(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

TEST_F(CalcOptions, MissingSectionsGiveTheDefaultsWhichLieWithinTheirLimits) {
    EXPECT_EQ(ReadOptionInt(path, kSectionCalculations, "Cheminements"), 32);
    EXPECT_TRUE(ReadOptionSwitch(path, kSectionCalculations, "IntersAvecHp"));
    EXPECT_EQ(ReadOptionReal(path, kSectionCorrections, "RayonTerre"), 6366);
    EXPECT_EQ(ReadOptionText(path, kSectionCorrections, "Projection"), "Aucune");
    EXPECT_EQ(ReadOptionReal(path, kSectionEditor, "TolerancePointDouble"), 0.05);
    EXPECT_TRUE(ReadOptionSwitch(path, kSectionDatabase, "RendrePtsInvariants"));
    EXPECT_EQ(ReadOptionReal(path, kSectionDatabase, "Tolérance"), 0.001); // a text holding a real
    EXPECT_EQ(ReadOptionText(path, kSectionListings, "RayonContenu"), "N,X,Y,Z,GI,DH");
    EXPECT_FALSE(ReadOptionSwitch(path, kSectionListings, "Inverser_XY"));
    EXPECT_EQ(ReadOptionReal(path, kSectionTolerances, "FermAngulaire"), 0.01);
    // A caller's slip reads as nothing rather than as another key's value.
    EXPECT_EQ(ReadOptionInt(path, kSectionTolerances, "TypeNivel"), 0);
    EXPECT_EQ(ReadOptionText(path, "Options_Inconnues", "Projection"), "");

    // A default outside its limits would be changed by every read.
    for (const auto& entry : CalcOptionTable()) {
        if (entry.type == OptionType::Text) continue;
        const double byDefault = std::stod(std::string(entry.defaultValue));
        EXPECT_TRUE(byDefault >= entry.minimum && byDefault <= entry.maximum)
            << entry.section << "/" << entry.key;
        EXPECT_EQ(ReadOptionReal(path, entry.section, entry.key), byDefault)
            << entry.section << "/" << entry.key;
    }

    COptionPSheet sheet = Sheet();
    EXPECT_EQ(sheet.Correct().Real("RayonTerre"), 6366);
    EXPECT_EQ(sheet.LinkDB().Text("Ident_Mat"), "NUMERO");
    EXPECT_EQ(sheet.Calcul().Int("General"), 7);
    EXPECT_FALSE(std::filesystem::exists(path)); // reading creates nothing
}

TEST_F(CalcOptions, ValuesOutsideTheirLimitsComeBackClamped) {
    WriteBytes(path, "[Options_Corrections]\nRayonTerre=5000\nAlterLineaire=-250000\n"
                     "[Options_Calculs]\nGeneral=9\nIntersAvecHp=5\n[Options_Nivellement]\nTypeNivel=-3\n");
    EXPECT_EQ(ReadOptionReal(path, kSectionCorrections, "RayonTerre"), 6000);
    EXPECT_EQ(ReadOptionReal(path, kSectionCorrections, "AlterLineaire"), -100000);
    EXPECT_EQ(ReadOptionInt(path, kSectionCalculations, "General"), 7);
    EXPECT_EQ(ReadOptionInt(path, kSectionCalculations, "IntersAvecHp"), 1);
    EXPECT_EQ(ReadOptionInt(path, kSectionLevelling, "TypeNivel"), 0);

    COptionPSheet sheet = Sheet();
    EXPECT_EQ(sheet.Correct().Real("RayonTerre"), 6000);
    // A widget's value is held within the limits too.
    sheet.Correct().SetReal("RayonTerre", 8000);
    sheet.Toler().SetInt("TypeCanevas", -1);
    EXPECT_EQ(sheet.Correct().Real("RayonTerre"), 7000);
    EXPECT_EQ(sheet.Toler().Int("TypeCanevas"), 0);
}

TEST_F(CalcOptions, LevellingAndTolerancesKeepTheirSameNamedKeysApart) {
    WriteBytes(path, "[Options_Nivellement]\nTypeTolerance=2\nFermAltimetr=0.05\n"
                     "[Options_Tolerances]\nTypeTolerance=1\nFermAltimetr=0.2\n");
    COptionPSheet sheet = Sheet();
    EXPECT_EQ(sheet.Nivel().Int("TypeTolerance"), 2);
    EXPECT_EQ(sheet.Toler().Int("TypeTolerance"), 1);
    sheet.Nivel().SetInt("TypeTolerance", 0);
    sheet.Toler().SetReal("FermAltimetr", 0.3);
    ASSERT_TRUE(sheet.OnOK());

    EXPECT_EQ(ReadOptionInt(path, kSectionLevelling, "TypeTolerance"), 0);
    EXPECT_EQ(ReadOptionInt(path, kSectionTolerances, "TypeTolerance"), 1);
    EXPECT_EQ(ReadOptionReal(path, kSectionLevelling, "FermAltimetr"), 0.05);
    EXPECT_EQ(ReadOptionReal(path, kSectionTolerances, "FermAltimetr"), 0.3);
}

TEST_F(CalcOptions, TheStoreTakesItsDecimalsAndAxisOrderFromTheOptions) {
    WriteBytes(path, "[Options_Editeur]\nNombreDecimaleXY=2\nNombreDecimaleZ=1\nNombreDecimaleAng=6\n"
                     "[Options_Listings]\nInverser_XY=1\n");
    ApplyStoreOptions(path);
    EXPECT_EQ(CPointGen::DeciXY(), 2);
    EXPECT_EQ(CPointGen::DeciZ(), 1);
    EXPECT_EQ(CStation::DeciAng(), 6);
    EXPECT_EQ(CAppareil::DeciAng(), 6);
    EXPECT_TRUE(CPointGen::SwapXY());

    // Texts that are not plain numbers: the leading integer, kept within 0 to 10, else the default.
    WriteBytes(path, "[Options_Editeur]\nNombreDecimaleXY= 3 décimales\nNombreDecimaleZ=25\n"
                     "NombreDecimaleAng=beaucoup\n");
    ApplyStoreOptions(path);
    EXPECT_EQ(CPointGen::DeciXY(), 3);
    EXPECT_EQ(CPointGen::DeciZ(), 10);
    EXPECT_EQ(CStation::DeciAng(), 5);
    EXPECT_FALSE(CPointGen::SwapXY());

    // Reading the sheet applies the file; its OK applies what it writes.
    SetStoreDecimals(4, 3, 5);
    COptionPSheet sheet = Sheet();
    sheet.Pages();
    EXPECT_EQ(CPointGen::DeciXY(), 3);
    sheet.Editor().SetText("NombreDecimaleXY", "1");
    sheet.Listing().SetSwitch("Inverser_XY", true);
    ASSERT_TRUE(sheet.OnOK());
    EXPECT_EQ(CReference::DeciXY(), 1);
    EXPECT_TRUE(CPointGen::SwapXY());
}

TEST_F(CalcOptions, OkWritesEveryKeyInItsFormatAndCancelWritesNothing) {
    const std::string handKept = "; réglages du cabinet\n[Options_Corrections]\nRayonTerre=6380\n";
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
    ASSERT_TRUE(sheet.OnOK());
    const std::string written = ReadBytes(path);
    for (const char* line :
         {"; réglages du cabinet", "RayonTerre=6378.500000", "AlterLineaire=0.000000", "Projection=Aucune",
          "General=7", "Cheminements=32", "IntersAvecHp=1", "NombreDecimaleXY=4",
          "RayonContenu=N,X,Y,Z,GI,DH,HP", "NomTableDonnées=Points levés", "Tolérance=0.001",
          "Appareil0=Appareil Standard", "SigmaPpm0=0.000000"})
        EXPECT_TRUE(Has(written, std::string(line) + "\n")) << line << "\n" << written;

    // What OK wrote reads back as the sheet held it.
    COptionPSheet again = Sheet();
    EXPECT_EQ(again.Lines(), sheet.Lines());
}

TEST_F(CalcOptions, TheStandardInstrumentIsAlwaysOfferedFirst) {
    EXPECT_EQ(ReadInstruments(path), std::vector<InstrumentOptions>{{kStandardInstrument}});

    // The file numbers its instruments as it likes; the list stops at the first missing name.
    WriteBytes(path, "[Définitions_Des_Appareils]\nAppareil0=TC 1800\nSigmaAh0=0.0003\nSigmaDi0=5\n"
                     "Appareil1=Appareil Standard\nSigmaPpm1=2\nAppareil3=Perdu\n");
    const auto instruments = ReadInstruments(path);
    ASSERT_EQ(instruments.size(), 2u);
    EXPECT_EQ(instruments[0].name, kStandardInstrument);
    EXPECT_EQ(instruments[0].sigmaPpm, 2);
    EXPECT_EQ(instruments[1].name, "TC 1800");
    EXPECT_EQ(instruments[1].sigmaAh, 0.0003);
    EXPECT_EQ(instruments[1].sigmaDi, 1); // clamped to 1 m

    COptionPSheet sheet = Sheet();
    CPagOptionAppareil& page = sheet.Appareil();
    EXPECT_EQ(page.Instruments(), instruments);
    EXPECT_FALSE(page.RemoveInstrument(0));
    EXPECT_EQ(page.AddInstrument(" "), -1);
    EXPECT_EQ(page.AddInstrument("DI 2002"), 2);
    page.SetInstrument(2, {"DI 2002", 0.0175, 0, 0.001, 0.001, 0.001, 1});
    ASSERT_TRUE(sheet.OnOK());
    const auto renumbered = ReadInstruments(path);
    ASSERT_EQ(renumbered.size(), 3u);
    EXPECT_EQ(renumbered[2].prismConstant, 0.0175);
    EXPECT_TRUE(Has(ReadBytes(path), "Appareil0=Appareil Standard\n"));

    // A removed instrument is not read back from what it left in the file.
    COptionPSheet fewer = Sheet();
    ASSERT_TRUE(fewer.Appareil().RemoveInstrument(1));
    ASSERT_TRUE(fewer.OnOK());
    const auto left = ReadInstruments(path);
    ASSERT_EQ(left.size(), 2u);
    EXPECT_EQ(left[1].name, "DI 2002");
}

TEST_F(CalcOptions, ACommandLineSettingWritesOnlyItsKey) {
    const std::string before = "[Options_Corrections]\nProjection=CC48\nRayonTerre=6366\nCorrAuto=1\n\n"
                               "[Options_Listings]\nAfficherListing=0\n";
    WriteBytes(path, before);
    ASSERT_EQ(
        RunSheet({"--regler", "Options_Corrections/RayonTerre=6378", "--regler",
                  "options_listings/inverser_xy=1", "--regler", "Options_Corrections/RayonTerre=6378.25"}),
        ui::DialogResult::Ok);
    EXPECT_TRUE(Refusals().empty());
    EXPECT_EQ(ReadBytes(path),
              "[Options_Corrections]\nProjection=CC48\nRayonTerre=6378.250000\nCorrAuto=1\n\n"
              "[Options_Listings]\nAfficherListing=0\nInverser_XY=1\n");
    EXPECT_EQ(frontEnd.lines, (Words{"Option réglée : Options_Corrections/RayonTerre=6378.250000",
                                     "Option réglée : Options_Listings/Inverser_XY=1"}));
    EXPECT_TRUE(CPointGen::SwapXY());
}

TEST_F(CalcOptions, ACommandLineSettingRefusedWritesNothingAndSaysWhy) {
    const std::string before = "[Options_Nivellement]\nTypeNivel=2\n";
    WriteBytes(path, before);
    const std::pair<std::string, std::string> cases[] = {
        {"Options_Corrections/RayonTerre=5000",
         "Options_Corrections/RayonTerre : la valeur 5000 est hors des limites (6000 à 7000)."},
        {"Options_Editeur/TolerancePointDouble=-0.5",
         "Options_Editeur/TolerancePointDouble : la valeur -0.5 est hors des limites (0 à 100)."},
        {"Options_Calculs/ValeurDeHp0=1e7",
         "Options_Calculs/ValeurDeHp0 : la valeur 1e7 est hors des limites (-999999 à 999999)."},
        {"Options_Corrections/RayonTerre=6378,5",
         "Options_Corrections/RayonTerre : la valeur « 6378,5 » n'est pas un nombre."},
        {"Options_Calculs/General=2.5",
         "Options_Calculs/General : la valeur « 2.5 » n'est pas un nombre entier."},
        {"Options_Listings/Inverser_XY=oui",
         "Options_Listings/Inverser_XY : la valeur « oui » doit être 0 ou 1."},
        {"Options_Inconnues/RayonTerre=6378", "Options_Inconnues : section d'options inconnue."},
        {"Options_Corrections/Rayon=6378", "Options_Corrections/Rayon : clé inconnue dans cette section."},
        {"Définitions_Des_Appareils/SigmaAh3=0.001",
         "Définitions_Des_Appareils/SigmaAh3 : pas d'appareil n°3 "
         "(les appareils de la liste vont de 0 à 0)."},
        {"Définitions_Des_Appareils/Appareil0=TC 1800",
         "Définitions_Des_Appareils/Appareil0 : l'appareil n°0 reste « Appareil Standard »."},
    };
    for (const auto& [setting, reason] : cases) {
        frontEnd.messages.clear();
        // A setting accepted before the refused one is not written either.
        EXPECT_EQ(
            RunSheet({"--regler", "Options_Nivellement/TypeNivel=1", "--regler", setting, "--afficher"}),
            ui::DialogResult::Failed);
        EXPECT_EQ(Refusals(), Words{reason}) << setting;
        EXPECT_EQ(ReadBytes(path), before) << setting;
        EXPECT_TRUE(frontEnd.lines.empty()) << setting;
    }
    frontEnd.messages.clear();
    EXPECT_EQ(RunSheet({"--regler", "RayonTerre=6378"}), ui::DialogResult::Failed);
    ASSERT_EQ(Refusals().size(), 1u);
    EXPECT_TRUE(Has(Refusals()[0], "Section/Clé=valeur")) << Refusals()[0];
}

TEST_F(CalcOptions, InstrumentsAreAddedAndSetFromTheCommandLine) {
    ASSERT_EQ(RunSheet({"--regler", "Définitions_Des_Appareils/Appareil1=TC 1800", "--regler",
                        "Définitions_Des_Appareils/SigmaAh1=0.0003"}),
              ui::DialogResult::Ok);
    const auto instruments = ReadInstruments(path);
    ASSERT_EQ(instruments.size(), 2u);
    EXPECT_EQ(instruments[1].name, "TC 1800");
    EXPECT_EQ(instruments[1].sigmaAh, 0.0003);

    // A value for an instrument not yet named, a name that skips a number.
    const std::pair<std::string, std::string> cases[] = {
        {"Définitions_Des_Appareils/SigmaAh2=0.0003",
         "Définitions_Des_Appareils/SigmaAh2 : un nouvel appareil "
         "se déclare d'abord par son nom, Appareil2."},
        {"Définitions_Des_Appareils/Appareil3=DI 2002",
         "Définitions_Des_Appareils/Appareil3 : un nouvel appareil "
         "prend le numéro 2, celui qui suit le dernier de la liste."},
    };
    for (const auto& [setting, reason] : cases) {
        frontEnd.messages.clear();
        EXPECT_EQ(RunSheet({"--regler", setting}), ui::DialogResult::Failed) << setting;
        EXPECT_EQ(Refusals(), Words{reason});
    }
    EXPECT_EQ(ReadInstruments(path), instruments);
}

TEST_F(CalcOptions, TheValuesAreShownAsAnInitialisationFileShowsThem) {
    WriteBytes(path,
               "[Options_Corrections]\nRayonTerre=6378\n[Définitions_Des_Appareils]\nAppareil1=TC 1800\n");
    ASSERT_EQ(RunSheet({"--afficher"}), ui::DialogResult::Ok);
    const Words shown = frontEnd.lines;
    ASSERT_GT(shown.size(), 70u);
    EXPECT_EQ(Words(shown.begin(), shown.begin() + 3),
              (Words{"[Définitions_Des_Appareils]", "Appareil0=Appareil Standard", "ConstPrisme0=0.000000"}));
    Words sections;
    for (std::size_t i = 0; i < shown.size(); ++i) {
        const std::string& line = shown[i];
        if (line.empty()) {
            ASSERT_LT(i + 1, shown.size());
            EXPECT_EQ(shown[i + 1].front(), '[') << "an empty line only before a section";
        } else if (line.front() == '[') {
            sections.push_back(line);
        } else {
            EXPECT_TRUE(Has(line, "=")) << line;
        }
    }
    EXPECT_EQ(sections, (Words{"[Définitions_Des_Appareils]", "[Options_Calculs]", "[Options_Corrections]",
                               "[Options_Editeur]", "[Liaison_Base_de_Données]", "[Options_Listings]",
                               "[Options_Nivellement]", "[Options_Tolerances]"}));
    for (const char* line : {"Appareil1=TC 1800", "SigmaPpm1=0.000000", "RayonTerre=6378.000000", "General=7",
                             "Projection=Aucune", "NombreDecimaleXY=4", "Ident_Mat=NUMERO"})
        EXPECT_NE(std::find(shown.begin(), shown.end(), line), shown.end()) << line;

    // Saved as a file, what is shown gives the same options.
    std::string copy;
    for (const auto& line : shown)
        copy += line + "\n";
    WriteBytes(path, copy);
    frontEnd.lines.clear();
    ASSERT_EQ(RunSheet({}), ui::DialogResult::Ok); // alone, the command shows the values too
    EXPECT_EQ(frontEnd.lines, shown);

    // Settings first, then the values with the new one.
    frontEnd.lines.clear();
    ASSERT_EQ(RunSheet({"--afficher", "--regler", "Options_Tolerances/TolAngles=0.005"}),
              ui::DialogResult::Ok);
    ASSERT_GT(frontEnd.lines.size(), 2u);
    EXPECT_EQ(frontEnd.lines[0], "Option réglée : Options_Tolerances/TolAngles=0.005000");
    EXPECT_EQ(frontEnd.lines[1], "");
    EXPECT_EQ(frontEnd.lines[2], "[Définitions_Des_Appareils]");
    EXPECT_EQ(frontEnd.lines.back(), "FermAltimetr=0.010000");
    EXPECT_NE(std::find(frontEnd.lines.begin(), frontEnd.lines.end(), "TolAngles=0.005000"),
              frontEnd.lines.end());
}

} // namespace
} // namespace pyr
