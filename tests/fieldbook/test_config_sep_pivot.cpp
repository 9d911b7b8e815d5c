// Delimited and columnar field books read by the reading commands, through the Quendal pivot: the same
// survey written by hand as a Quendal-Pc, a delimited and a columnar field book gives the same GéoBase, and
// the lines a conversion cannot use are reported with their number in the surveyor's file.
#include "FieldBookTestSupport.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/FieldBookFormats.h"

#include <algorithm>
#include <filesystem>
#include <gtest/gtest.h>

using namespace pyr;
namespace fs = std::filesystem;

TEST(SepColConversion, TheSameSurveyInTheThreeFormatsGivesTheSameGeoBase) {
    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
    // A field book or layout of the test data, copied into the test's folder (where the .tmp goes).
    const auto copy = [&](const std::string& name) {
        fs::copy_file(FieldBookData(name), dir / name);
        return std::string(dir / name);
    };
    // Converts a field book into a new GéoBase beside it, through the command's reader; its text.
    const auto convert = [&](FieldBookFormat format, const std::string& carnet,
                             const std::string& layout = {}) {
        frontEnd.dialogArguments = {carnet};
        if (!layout.empty())
            frontEnd.dialogArguments.insert(frontEnd.dialogArguments.end(), {"--parametrage", layout});
        FieldBookConverter converter(format, &frontEnd, dir / "Pyralis.ini", dir / "installation/", &txt);
        EXPECT_EQ(RunConversion(converter, nullptr), ui::DialogResult::Ok) << frontEnd.AllLines();
        return ReadBytes(BesideCarnet(carnet, "geo"));
    };
    const std::string quendal = convert(FieldBookFormat::Quendal, copy("leve-quendal.txt"));
    // A line that cannot be used is reported with its number in the surveyor's file, the others kept.
    const std::string csv = copy("leve-separateur.csv");
    WriteBytes(csv, ReadBytes(csv) + "XX;205\n");
    const std::string delimited = convert(FieldBookFormat::Separateur, csv, copy("leve.sep"));
    WriteBytes(dir / "leve-colonne.tmp", "à garder\n"); // the surveyor's own file, not ours to touch
    const std::string columnar =
        convert(FieldBookFormat::Colonne, copy("leve-colonne.txt"), copy("leve.col"));
    std::vector<std::string> errors;
    std::copy_if(
        frontEnd.lines.begin(), frontEnd.lines.end(), std::back_inserter(errors),
        [](const std::string& line) { return line.starts_with("Erreur") || line.starts_with("Attention"); });
    EXPECT_EQ(errors, (std::vector<std::string>{"Erreur ligne 14 : donnée non reconnue !"}));
    EXPECT_EQ(delimited, quendal);
    EXPECT_EQ(columnar, quendal);
    // The temporary Quendal-Pc files are gone, and the one that was there before is kept.
    EXPECT_FALSE(fs::exists(dir / "leve-separateur.tmp"));
    EXPECT_EQ(ReadBytes(dir / "leve-colonne.tmp"), "à garder\n");
    EXPECT_FALSE(fs::exists(dir / "leve-colonne.tmp.tmp"));

    // And the GéoBase holds the survey: a comment, three points, two stations and their sightings, a code.
    CCarnet geoBase;
    ASSERT_TRUE(geoBase.Load(nullptr, BesideCarnet(csv, "geo")));
    std::vector<int> kinds;
    for (int i = 0; i < geoBase.GetSize(); ++i)
        kinds.push_back(geoBase.GetType(i));
    EXPECT_EQ(kinds, (std::vector<int>{kKindComment, kKindPoint, kKindPoint, kKindPoint, kKindStation,
                                       kKindReference, kKindMesure, kKindCommand, kKindMesure, kKindStation,
                                       kKindMesure}));
}
