// The parameter set of a format: the files shipped in Config are right, a wrong value is refused with its
// reason, the delimited and columnar layouts are read into their fields.
#include "FieldBookTestSupport.h"
#include "fieldbook/ParamDriver.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

std::string Shipped(const char* name) {
    return std::string(PYR_SOURCE_DIR) + "/data/Config/" + name;
}

} // namespace

TEST(ParamDriver, EveryShippedFileValidatesAndHoldsEveryKeyOfItsFormat) {
    for (const auto& info : FieldBookFormats()) {
        if (!info.parameterFile) continue;
        ui::ScriptedFrontEnd frontEnd;
        CParamDriver driver("", Shipped(info.parameterFile), info.format);
        EXPECT_TRUE(driver.Load(&frontEnd)) << info.parameterFile;
        EXPECT_TRUE(frontEnd.messages.empty()) << info.parameterFile;
        const std::string text = ReadBytes(Shipped(info.parameterFile));
        for (const auto& key : driver.Keys())
            EXPECT_NE(text.find(std::string("\n") + key.name + "="), std::string::npos)
                << info.parameterFile << " " << key.name;
    }
}

TEST(ParamDriver, TheValuesOfTheInstrumentFormats) {
    TempDir dir;
    WriteBytes(dir / "Wild.ini", "[Parametrage]\nUniteAngles=DMS\nUniteDistances=pieds\nOrdreCoordonnees=yx\n"
                                 "References=codes\nCodesReference= REF, V0 ,\nConventionStation=41\n");
    CParamDriver driver("", dir / "Wild.ini", FieldBookFormat::Wild);
    ASSERT_TRUE(driver.Load(nullptr));
    EXPECT_EQ(driver.Angles(), AngleUnit::Dms);
    EXPECT_EQ(driver.Distances(), DistanceUnit::Feet);
    EXPECT_EQ(driver.Order(), CoordinateOrder::NorthEast);
    EXPECT_EQ(driver.References(), ReferenceMarking::Codes);
    EXPECT_EQ(driver.ReferenceCodes(), (std::vector<std::string>{"REF", "V0"}));
    EXPECT_EQ(driver.Stations(), StationConvention::CodeBlock41);
    EXPECT_EQ(driver.StationCodes(), (std::vector<std::string>{"2", "21"})); // the default
}

TEST(ParamDriver, AWrongValueIsRefusedWithItsReason) {
    TempDir dir;
    const std::string sep = dir / "p.sep";
    const std::string col = dir / "p.col";
    const struct {
        FieldBookFormat format;
        std::string path;
        std::string contents;
        std::string why; // after "Fichier de paramétrage <path> :\n"
    } cases[] = {
        {FieldBookFormat::Sokkia, dir / "s.ini", "[Parametrage]\nUniteAngles=radians\n",
         "valeur « radians » incorrecte pour UniteAngles (valeurs possibles : grades, degres, dms, mils) !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nLignesEntete=-1\n",
         "valeur « -1 » incorrecte pour LignesEntete (un nombre entier de 0 à 1000) !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nSeparateur=\"\"\n",
         "Separateur incorrect : le séparateur est vide !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nChampsPoint=TYPE,MATRICULE,X,Y,W\n",
         "ChampsPoint incorrect : champ inconnu « W » !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nChampsPoint=TYPE,MATRICULE,X,X\n",
         "ChampsPoint incorrect : champ « X » donné deux fois !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nChampsVisee=TYPE,MATRICULE,X\n",
         "ChampsVisee incorrect : champ « X » inattendu pour ce type d'enregistrement !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nChampsStation=TYPE,HI\n",
         "ChampsStation incorrect : le champ MATRICULE manque !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nChampsPoint=MATRICULE,X,Y\n",
         "ChampsPoint incorrect : le champ TYPE doit figurer dans toutes les listes ou dans aucune !"},
        {FieldBookFormat::Separateur, sep, "[Parametrage]\nChampsPoint=TYPE:1-2,MATRICULE\n",
         "ChampsPoint incorrect : colonnes données au champ « TYPE » d'un format séparateur !"},
        {FieldBookFormat::Colonne, col, "[Parametrage]\nChampsPoint=TYPE:1-2,MATRICULE\n",
         "ChampsPoint incorrect : champ « MATRICULE » sans ses colonnes (MATRICULE:début-fin) !"},
        {FieldBookFormat::Colonne, col, "[Parametrage]\nChampsPoint=TYPE:1-2,MATRICULE:9-4\n",
         "ChampsPoint incorrect : colonnes incorrectes pour le champ « MATRICULE » !"},
    };
    for (const auto& c : cases) {
        WriteBytes(c.path, c.contents);
        ui::ScriptedFrontEnd frontEnd;
        CParamDriver driver("", c.path, c.format);
        EXPECT_FALSE(driver.Load(&frontEnd)) << c.contents;
        EXPECT_EQ(MessageTexts(frontEnd), "Fichier de paramétrage <" + c.path + "> :\n" + c.why);
    }
    ui::ScriptedFrontEnd frontEnd;
    CParamDriver missing("", dir / "absent.ini", FieldBookFormat::Zeiss);
    EXPECT_FALSE(missing.Load(&frontEnd));
    EXPECT_EQ(
        MessageTexts(frontEnd).find("Impossible de lire le fichier de paramétrage <" + dir / "absent.ini"),
        0u);
    EXPECT_EQ(frontEnd.messages.size(), 1u);
}

TEST(ParamDriver, TheLayoutsOfTheDelimitedAndColumnarFiles) {
    TempDir dir;
    WriteBytes(dir / "p.sep", "[Parametrage]\nSeparateur=TAB\nSeparateurDecimal=,\nLignesEntete=2\n"
                              "ChampsStation=TYPE,MATRICULE,IGNORE,HI\nChampsVisee=\n");
    CParamDriver delimited("", dir / "p.sep", FieldBookFormat::Separateur);
    ASSERT_TRUE(delimited.Load(nullptr));
    const RecordLayout layout = delimited.Layout();
    EXPECT_FALSE(layout.columnar);
    EXPECT_EQ(layout.separator, "\t");
    EXPECT_EQ(layout.decimal, ',');
    EXPECT_EQ(layout.headerLines, 2);
    EXPECT_EQ(layout.typeStation, "ST");
    using F = RecordField;
    EXPECT_EQ(layout.station, (std::vector<FieldPlace>{{F::Type}, {F::Matricule}, {F::Ignore}, {F::HI}}));
    EXPECT_TRUE(layout.sighting.empty()); // not read
    EXPECT_EQ(layout.point.size(), 6u);

    CParamDriver columnar("", Shipped("Param_Export.col"), FieldBookFormat::Colonne);
    ASSERT_TRUE(columnar.Load(nullptr));
    const RecordLayout columns = columnar.Layout();
    EXPECT_TRUE(columns.columnar);
    EXPECT_EQ(columns.point.front(), (FieldPlace{F::Type, 1, 2}));
    EXPECT_EQ(columns.point.back(), (FieldPlace{F::Code, 62, 0}));
}

// The "editor": the file shown; a new one is a copy of the installation's, or holds the defaults.
TEST(ParamDriver, EditingANewFileMakesItAndShowsIt) {
    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CParamDriver driver("", dir / "Neuf.ini", FieldBookFormat::Wild);
    driver.Edit(frontEnd);
    EXPECT_EQ(frontEnd.shownFiles, std::vector<std::string>{dir / "Neuf.ini"});
    CParamDriver reread("", dir / "Neuf.ini", FieldBookFormat::Wild);
    ASSERT_TRUE(reread.Load(nullptr));
    EXPECT_EQ(reread.Text(kKeyCodesStation), "2,21");
    EXPECT_EQ(reread.Angles(), AngleUnit::Grads);

    const std::string install = std::string(PYR_SOURCE_DIR) + "/data/";
    CParamDriver copied(install, dir / "Copie.ini", FieldBookFormat::Wild);
    copied.Edit(frontEnd);
    EXPECT_EQ(ReadBytes(dir / "Copie.ini"), ReadBytes(Shipped("Wild.ini")));
}
