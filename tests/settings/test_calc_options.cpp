#include "SettingsTestSupport.h"
#include "settings/CalcOptions.h"
#include "settings/OptionPages.h"

#include <regex>

namespace pyr {
namespace {

using Words = std::vector<std::string>;

class CalcOptions : public test::SettingsTest {
protected:
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
        COptionPSheet sheet = Sheet();
        EXPECT_EQ(frontEnd.DoModal(sheet), expected);
        return Texts(frontEnd, ui::kIconWarning);
    }
};

TEST_F(CalcOptions, ReadsHoldValuesWithinTheirLimitsAndGiveTheStoreItsDecimalsAndAxisOrder) {
    // A default outside its limits would be changed by every read.
    for (const auto& entry : CalcOptionTable()) {
        if (entry.type == OptionType::Text) continue;
        EXPECT_EQ(ReadOptionReal(path, entry.section, entry.key), std::stod(std::string(entry.defaultValue)))
            << entry.key;
    }
    EXPECT_EQ(ReadOptionReal(path, kSectionDatabase, "Tolérance"), 0.001); // a text holding a real
    EXPECT_FALSE(std::filesystem::exists(path));                           // reading creates nothing

    // The store's decimals are texts: their leading integer, within 0 to 10, else the default.
    WriteBytes(path,
               "[Options_Corrections]\nRayonTerre=5000\n[Options_Editeur]\nNombreDecimaleXY= 3 décimales\n"
               "NombreDecimaleZ=25\nNombreDecimaleAng=beaucoup\n[Options_Listings]\nInverser_XY=1\n");
    EXPECT_EQ(ReadOptionReal(path, kSectionCorrections, "RayonTerre"), 6000);
    SetStoreDecimals(0, 0, 0);
    COptionPSheet sheet = Sheet();               // reading the sheet sets the store
    sheet.Correct().SetReal("RayonTerre", 8000); // a widget's value is held within the limits too
    EXPECT_EQ(sheet.Correct().Real("RayonTerre"), 7000);
    EXPECT_EQ(CPointGen::DeciXY(), 3);
    EXPECT_EQ(CPointGen::DeciZ(), 10);
    EXPECT_EQ(CStation::DeciAng(), 5);
    EXPECT_TRUE(CPointGen::SwapXY());
}

TEST_F(CalcOptions, OkWritesEveryKeyInItsFormatAndCancelWritesNothing) {
    const std::string handKept =
        "; réglages du cabinet\n[Options_Nivellement]\nTypeTolerance=2\nFermAltimetr=0.05\n"
        "[Options_Tolerances]\nTypeTolerance=1\nFermAltimetr=0.2\n";
    WriteBytes(path, handKept);
    Sheet().OnCancel(); // neither Cancel nor the sheet's end writes a byte
    EXPECT_EQ(ReadBytes(path), handKept);

    COptionPSheet sheet = Sheet();
    sheet.Correct().SetReal("RayonTerre", 6378.5);
    sheet.Listing().AddRadiatedColumn("HP");
    sheet.Listing().SetSwitch("Inverser_XY", true);
    sheet.Nivel().SetInt("TypeTolerance", 0);
    sheet.Toler().SetReal("FermAltimetr", 0.3);
    ASSERT_TRUE(sheet.OnOK());
    EXPECT_TRUE(CPointGen::SwapXY()); // the store follows what OK wrote
    for (const char* line :
         {"; réglages du cabinet", "RayonTerre=6378.500000", "General=7", "RayonContenu=N,X,Y,Z,GI,DH,HP"})
        EXPECT_NE(ReadBytes(path).find(std::string(line) + "\n"), std::string::npos) << line;
    EXPECT_EQ(Sheet().Lines(), sheet.Lines()); // what OK wrote reads back as the sheet held it
    EXPECT_EQ(ReadOptionInt(path, kSectionTolerances, "TypeTolerance"), 1);   // not levelling's of that name
    EXPECT_EQ(ReadOptionReal(path, kSectionLevelling, "FermAltimetr"), 0.05); // nor the other way round
}

TEST_F(CalcOptions, TheStandardInstrumentIsAlwaysOfferedFirst) {
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
    ASSERT_TRUE(page.RemoveInstrument(1));
    ASSERT_TRUE(sheet.OnOK());
    EXPECT_EQ(ReadInstruments(path), page.Instruments()); // not the one left behind in the file
}

TEST_F(CalcOptions, ACommandLineSettingWritesOnlyItsKey) {
    WriteBytes(path, "[Options_Corrections]\nProjection=CC48\nRayonTerre=6366\nCorrAuto=1\n\n"
                     "[Options_Listings]\nAfficherListing=0\n");
    // A key given twice is written once, with its last value; a new instrument is named, then set.
    RunSheet({"--regler", "Options_Corrections/RayonTerre=6378", "--regler", "options_listings/inverser_xy=1",
              "--regler", "Options_Corrections/RayonTerre=6378.25", "--regler",
              "Définitions_Des_Appareils/Appareil1=TC 1800", "--regler",
              "Définitions_Des_Appareils/SigmaAh1=0.0003"},
             ui::DialogResult::Ok);
    EXPECT_EQ(
        ReadBytes(path),
        "[Options_Corrections]\nProjection=CC48\nRayonTerre=6378.250000\nCorrAuto=1\n\n"
        "[Options_Listings]\nAfficherListing=0\nInverser_XY=1\n"
        "\n[Définitions_Des_Appareils]\nAppareil1=TC 1800\nConstPrisme1=0.000000\nCollVerticale1=0.000000\n"
        "SigmaAh1=0.000300\nSigmaAv1=0.000000\nSigmaDi1=0.000000\nSigmaPpm1=0.000000\n");
    EXPECT_EQ(frontEnd.lines.at(1), "Option réglée : Options_Listings/Inverser_XY=1");
    EXPECT_TRUE(CPointGen::SwapXY());
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
    WriteBytes(path, "[Options_Corrections]\nRayonTerre=6378\n");
    RunSheet({"--afficher"}, ui::DialogResult::Ok);
    const Words shown = frontEnd.lines;
    std::string copy;
    Words sections;
    for (const auto& line : shown) {
        copy += line + "\n";
        if (line.starts_with('[')) sections.push_back(line);
    }
    // Each section after an empty line but the first, and under it its keys with their values.
    const std::string section = R"(\[[^\n\]]+\]\n([^\n\[=]+=[^\n]*\n)*)";
    EXPECT_TRUE(std::regex_match(copy, std::regex(section + "(\n" + section + ")*"))) << copy;
    EXPECT_EQ(sections, (Words{"[Définitions_Des_Appareils]", "[Options_Calculs]", "[Options_Corrections]",
                               "[Options_Editeur]", "[Liaison_Base_de_Données]", "[Options_Listings]",
                               "[Listings]", "[Options_Nivellement]", "[Options_Tolerances]"}));
    for (const char* line : {"Appareil0=Appareil Standard", "SigmaPpm0=0.000000", "RayonTerre=6378.000000"})
        EXPECT_NE(std::find(shown.begin(), shown.end(), line), shown.end()) << line;

    // Saved as a file, what is shown gives the same options; alone, the command shows them too.
    WriteBytes(path, copy);
    RunSheet({}, ui::DialogResult::Ok);
    EXPECT_EQ(frontEnd.lines, shown);
}

} // namespace
} // namespace pyr
