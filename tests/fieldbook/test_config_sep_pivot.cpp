// Delimited and columnar field books read by the reading commands, through the Quendal pivot: the same
// survey written by hand as a Quendal-Pc, a delimited and a columnar field book gives the same GéoBase, and
// the lines a conversion cannot use are reported with their number in the surveyor's file.
#include "FieldBookTestSupport.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/FieldBookFormats.h"

#include <filesystem>
#include <gtest/gtest.h>

using namespace pyr;
namespace fs = std::filesystem;

namespace {

class SepColConversion : public ::testing::Test {
protected:
    // A field book or layout of the test data, copied into the test's folder (where the .tmp goes).
    std::string Copy(const std::string& name) {
        fs::copy_file(FieldBookData(name), dir / name);
        return dir / name;
    }
    // Converts a field book into a new GéoBase beside it, through the command's reader; its text.
    std::string Convert(FieldBookFormat format, const std::string& carnet, const std::string& layout = {}) {
        frontEnd.dialogArguments = {carnet};
        if (!layout.empty())
            frontEnd.dialogArguments.insert(frontEnd.dialogArguments.end(), {"--parametrage", layout});
        FieldBookConverter converter(format, &frontEnd, dir / "Pyralis.ini", dir / "installation/", &txt);
        EXPECT_EQ(RunConversion(converter, nullptr), ui::DialogResult::Ok) << frontEnd.AllLines();
        return ReadBytes(BesideCarnet(carnet, "geo"));
    }
    std::vector<std::string> Errors() const {
        std::vector<std::string> errors;
        for (const auto& line : frontEnd.lines)
            if (line.starts_with("Erreur") || line.starts_with("Attention")) errors.push_back(line);
        return errors;
    }

    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
};

} // namespace

TEST_F(SepColConversion, TheSameSurveyInTheThreeFormatsGivesTheSameGeoBase) {
    const std::string quendal = Convert(FieldBookFormat::Quendal, Copy("leve-quendal.txt"));
    const std::string delimited =
        Convert(FieldBookFormat::Separateur, Copy("leve-separateur.csv"), Copy("leve.sep"));
    const std::string columnar =
        Convert(FieldBookFormat::Colonne, Copy("leve-colonne.txt"), Copy("leve.col"));
    EXPECT_TRUE(Errors().empty()) << frontEnd.AllLines();
    EXPECT_EQ(delimited, quendal);
    EXPECT_EQ(columnar, quendal);
    // The temporary Quendal-Pc files are gone.
    EXPECT_FALSE(fs::exists(dir / "leve-separateur.tmp"));
    EXPECT_FALSE(fs::exists(dir / "leve-colonne.tmp"));

    // And the GéoBase holds the survey: the comment, three points, two stations and their sightings, the
    // field code; the distance not measured stays missing, the prism height 0 is a height.
    CCarnet geoBase;
    ASSERT_TRUE(geoBase.Load(nullptr, BesideCarnet(dir / "leve-separateur.csv", "geo")));
    const std::vector<int> kinds{kKindComment, kKindPoint,     kKindPoint,  kKindPoint,
                                 kKindStation, kKindReference, kKindMesure, kKindCommand,
                                 kKindMesure,  kKindStation,   kKindMesure};
    ASSERT_EQ(geoBase.GetSize(), static_cast<int>(kinds.size()));
    for (int i = 0; i < geoBase.GetSize(); ++i)
        EXPECT_EQ(geoBase.GetType(i), kinds[i]) << i;
    EXPECT_EQ(geoBase.As<CComment>(0)->text(), "Levé de la rue des Tilleuls ; 12 mars");
    EXPECT_EQ(geoBase.xAt(3), kUndefined);
    EXPECT_DOUBLE_EQ(geoBase.zAt(3), 58.412);
    EXPECT_EQ(geoBase.v0At(4), kUndefined);
    EXPECT_DOUBLE_EQ(geoBase.v0At(9), 12.3456);
    EXPECT_EQ(geoBase.cmdAt(7), "ARB 6");
    EXPECT_EQ(geoBase.diAt(8), kUndefined);
    EXPECT_EQ(geoBase.hpAt(10), 0.0);
}

TEST_F(SepColConversion, ABadLineIsReportedWithItsNumberInTheFieldBookAndTheOthersKept) {
    WriteBytes(dir / "terrain.txt", "ST;S1;1.55\n"
                                    "MS;101;1.3;12.5;100;25.3\n"
                                    "XX;102;1.3;13.5;100;26.3\n"
                                    "MS;;1.3;14.5;100;27.3\n"
                                    "MS;104;1.3;15.5x;100;28.3\n"
                                    "MS;105;1.3;16.5;100;29.3\n");
    const std::string layout = std::string(PYR_SOURCE_DIR) + "/data/Config/Param_Export.sep";
    Convert(FieldBookFormat::Separateur, dir / "terrain.txt", layout);
    EXPECT_EQ(Errors(),
              (std::vector<std::string>{"Erreur ligne 3 : donnée non reconnue !",
                                        "Erreur ligne 4 : donnée manquante pour le matricule du point !",
                                        "Erreur ligne 5 : valeur numérique incorrecte <15.5x> !"}));
    CCarnet geoBase;
    ASSERT_TRUE(geoBase.Load(nullptr, dir / "terrain.geo"));
    ASSERT_EQ(geoBase.GetSize(), 3);
    EXPECT_EQ(geoBase.matAt(1), "101");
    EXPECT_EQ(geoBase.matAt(2), "105");
    EXPECT_FALSE(fs::exists(dir / "terrain.tmp"));
}
