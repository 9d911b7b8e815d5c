// The editor's reading menu: a field book read into the open GéoBase, or into a new one.
#include "TestSupport.h"
#include "editor/GeoEditor.h"
#include "geobase/Carnet.h"
#include "settings/LastGeoBase.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>

namespace {

using pyr::ui::Answer;
using pyr::ui::DialogResult;

constexpr const char* kBook = "QUENDAL-PC;1\nSTATION;S1;1.562\nMESURE;102;1.8;388.64623;99.18242;111.5994\n";
constexpr const char* kJob = "GEOBASE PYRALIS\t1\n1000\tLevé du 2 mars\n";

class EditorReading : public ::testing::Test {
protected:
    EditorReading() {
        WriteBytes(dir / "carnet.qdl", kBook);
        WriteBytes(dir / "job.geo", kJob);
    }
    DialogResult Read(std::vector<Answer> answers) {
        frontEnd.answers.assign(answers.begin(), answers.end());
        frontEnd.dialogArguments = {dir / "job.geo", "--lecture", "Quendal", dir / "carnet.qdl"};
        pyr::CGeoEditor editor;
        editor.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        return frontEnd.DoModal(editor);
    }
    int Elements(const std::string& path) {
        pyr::CCarnet carnet;
        return carnet.Load(nullptr, path) ? carnet.GetSize() : -1;
    }

    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    pyr::ui::ScriptedFrontEnd frontEnd;
};

} // namespace

TEST_F(EditorReading, CancelGivesUpNoMakesANewGeoBaseYesAppends) {
    const std::string question =
        "La GéoBase courante n'est pas vide !\nVoulez-vous ajouter les nouvelles données à "
        "la fin de celle-ci ?\n(Répondez par NON pour créer une nouvelle GéoBase.)";
    EXPECT_EQ(Read({Answer::Cancel}), DialogResult::Cancel);
    EXPECT_EQ(frontEnd.questions, std::vector<std::string>{question});
    EXPECT_EQ(ReadBytes(dir / "job.geo"), kJob);

    EXPECT_EQ(Read({Answer::No}), DialogResult::Ok);
    EXPECT_EQ(ReadBytes(dir / "job.geo"), kJob); // left as it was
    EXPECT_EQ(Elements(dir / "carnet.geo"), 2);
    EXPECT_EQ(pyr::ReadLastGeoBase(dir / "Pyralis.ini"), dir / "carnet.geo");

    // A new GéoBase that exists already is replaced only when the person says so.
    frontEnd.questions.clear();
    EXPECT_EQ(Read({Answer::No, Answer::No}), DialogResult::Cancel);
    EXPECT_EQ(frontEnd.questions.back(), "La GéoBase indiquée existe déjà !\nVoulez-vous la remplacer ?");
    // Yes appends: the editor's window and pyralis's reading commands check what it adds.
}

// A file that is not a GéoBase (a raw field book opened by mistake): No to adding makes the new GéoBase
// under the field book's name and leaves the raw file alone. Yes, refused, is checked where pyralis runs
// the same reading (GeoBaseSafety).
TEST_F(EditorReading, AFileThatIsNotAGeoBaseIsNeverWrittenOver) {
    const std::string raw = "410001+0000STA1 42....+00001.55 \r\n110002+00000001 21.102+00000000 \r\n";
    WriteBytes(dir / "job.geo", raw);
    EXPECT_EQ(Read({Answer::No}), DialogResult::Ok);
    EXPECT_EQ(Elements(dir / "carnet.geo"), 2);
    EXPECT_EQ(ReadBytes(dir / "job.geo"), raw);
}
