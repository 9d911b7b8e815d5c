// The export dialog: the names it proposes, the settings it keeps, what it exports of a GéoBase in each
// scope, and how an existing file is treated.
#include "FieldBookTestSupport.h"
#include "fieldbook/ConfigQdl.h"
#include "fieldbook/ExportCommand.h"
#include "fieldbook/ExportPoints.h"
#include "fieldbook/ExportPointsForm.h"
#include "fieldbook/QuendalReader.h"
#include "geobase/GeoFile.h"
#include "settings/ParamStore.h"

#include <filesystem>

namespace pyr {
namespace {

namespace fs = std::filesystem;

// A small job: a station with its sightings, an instrument, a comment, points of two prefixes.
CCarnet Job() {
    CCarnet c;
    c.Add(std::make_unique<CComment>("Chantier des Tilleuls"), kKindComment);
    c.Add(std::make_unique<CPointGen>("A1", 1000.0, 2000.0, 100.0, "BORNE"), kKindPoint);
    c.Add(std::make_unique<CPointGen>("A007", 1010.0, 2010.0, 101.0), kKindPoint);
    c.Add(std::make_unique<CStation>("A1", 1.55), kKindStation);
    c.Add(std::make_unique<CReference>("A007", 1.3, 12.3456, 99.5, 14.142), kKindReference);
    c.Add(std::make_unique<CMesure>("A10", 1.3, 112.3456, 100.5, 24.142), kKindMesure);
    c.Add(std::make_unique<CPointGen>("A10", 1020.0, 1990.0, kUndefined), kKindPoint);
    c.Add(std::make_unique<CPointGen>("B5", 990.0, 2005.0, 99.0), kKindPoint);
    return c;
}

// The elements of a GéoBase as its file writes them.
std::string Lines(const CCarnet& c) {
    std::string text;
    for (int i = 0; i < c.GetSize(); ++i)
        text += std::to_string(c.GetType(i)) + " " + c.matAt(i) + "\n";
    return text;
}

CCarnet SavedGeoBase(const std::string& path) {
    CCarnet c;
    c.Load(nullptr, path);
    return c;
}

class ExportDialog : public ::testing::Test {
protected:
    ExportDialog() {
        fs::create_directories(dir / "inst/Config");
        geo = dir / "job.geo";
        carnet = Job();
        carnet.SetPathName(geo);
    }
    // A dialog on the job in memory (or, without, on the job's file), opened.
    CDlgExportPoints& Open(std::optional<int> format, bool inMemory = true,
                           const std::vector<int>* selection = nullptr) {
        dialog = std::make_unique<CDlgExportPoints>(inMemory ? &carnet : nullptr, selection, format);
        dialog->SetInputs({geo, params, dir / "inst/", "export"});
        dialog->OnInitDialog();
        return *dialog;
    }
    std::string Read(const std::string& key) const {
        std::string value;
        ReadParamString(params, "ExportationPoints", key, "<absent>", value);
        return value;
    }

    TempDir dir;
    std::string params = dir / "Pyralis.ini";
    std::string geo;
    CCarnet carnet;
    std::unique_ptr<CDlgExportPoints> dialog;
    ui::ScriptedFrontEnd frontEnd;
};

TEST(ExportNames, EachFormatProposesItsNameBesideTheGeoBase) {
    const std::string job = (fs::path("/travaux") / "job.geo").string();
    const auto beside = [](const char* name) { return (fs::path("/travaux") / name).string(); };
    EXPECT_EQ(CDlgExportPoints::DerivedOutput(job, 0), beside("job_2.geo"));
    EXPECT_EQ(CDlgExportPoints::DerivedOutput(job, 1), beside("job.txt"));
    EXPECT_EQ(CDlgExportPoints::DerivedOutput(job, 3), beside("job.txt"));
    EXPECT_EQ(CDlgExportPoints::DerivedOutput(job, 6), beside("job_2.sdr"));
    EXPECT_EQ(CDlgExportPoints::DerivedOutput(job, 7), beside("job.dxf"));
    EXPECT_EQ(CDlgExportPoints::DerivedOutput("", 1), "");
    EXPECT_EQ(CDlgExportPoints::FormatList().at(5), "Fichier carnet Trimble GDM");
}

TEST_F(ExportDialog, TheFormatAndTheSourceNameTheFileAndTheWordingFollowsTheFormat) {
    CDlgExportPoints& d = Open(std::nullopt, false);
    EXPECT_TRUE(d.SourceVisible());
    EXPECT_EQ(d.Format(), 1); // no setting yet: the delimited format
    EXPECT_EQ(d.Output(), dir / "job.txt");
    d.SetFormat(6);
    EXPECT_EQ(d.Output(), dir / "job_2.sdr");
    EXPECT_EQ(d.GroupTitle(), "Points à exporter");
    EXPECT_FALSE(d.ElementBoxesVisible());
    EXPECT_EQ(d.ParamFile(), dir / "inst/Config/Export_Sokkia.ini");
    d.SetFormat(3);
    EXPECT_EQ(d.GroupTitle(), "Eléments à exporter");
    EXPECT_EQ(d.SelectedText(), "&Uniquement les éléments sélectionnés");
    EXPECT_EQ(d.AllText(), "Tous les éléments de la &GéoBase courante");
    EXPECT_TRUE(d.ElementBoxesVisible());
    EXPECT_FALSE(d.ParamFileVisible());
    // No selection: only the whole GéoBase or a range.
    EXPECT_FALSE(d.SelectedEnabled());
    d.SetScope(CDlgExportPoints::kSelected);
    EXPECT_EQ(d.ScopeChoice(), CDlgExportPoints::kAll);
    // Typing a first identifier asks for the range, where observations are not written.
    d.SetFrom("A1");
    EXPECT_EQ(d.ScopeChoice(), CDlgExportPoints::kRange);
    EXPECT_FALSE(d.WriteCarnetEnabled());
    d.SetSource(dir / "autre.geo");
    EXPECT_EQ(d.Output(), dir / "autre.txt");

    CDlgExportPoints& inMemory = Open(7);
    EXPECT_FALSE(inMemory.SourceVisible());
    EXPECT_EQ(inMemory.Output(), dir / "job.dxf");
    inMemory.SetFormat(2); // an imposed format stays
    EXPECT_EQ(inMemory.Format(), 7);
}

TEST_F(ExportDialog, SettingsAreWrittenBackOnOkButTheLeicaFileNeverIs) {
    WriteBytes(params, "[ExportationPoints]\r\nDernierFormat=3\r\nParametresLeica=/reglages/gsi16.ini\r\n"
                       "EcrireCarnet=0\r\n");
    CDlgExportPoints& d = Open(std::nullopt);
    EXPECT_EQ(d.Format(), 3);
    EXPECT_FALSE(d.WriteCarnet());
    d.SetFormat(4);
    EXPECT_EQ(d.ParamFile(), "/reglages/gsi16.ini");
    d.SetParamFile("/reglages/gsi8.ini");
    d.SetFormat(6);
    d.SetParamFile("/reglages/sdr33.ini");
    d.SetFormat(3);
    d.SetViewFile(true);
    ASSERT_EQ(d.OnOK(frontEnd), ui::DialogResult::Ok) << MessageTexts(frontEnd);
    EXPECT_EQ(Read("DernierFormat"), "3");
    EXPECT_EQ(Read("ParametresSokkia"), "/reglages/sdr33.ini");
    EXPECT_EQ(Read("ParametresLeica"), "/reglages/gsi16.ini");
    EXPECT_EQ(Read("VisualiserFichier"), "1");
    EXPECT_EQ(frontEnd.shownFiles, std::vector<std::string>{dir / "job.txt"});
    // The next opening shows the former Leica file again; an imposed format does not read the last one.
    CDlgExportPoints& again = Open(4);
    EXPECT_EQ(again.ParamFile(), "/reglages/gsi16.ini");
    EXPECT_EQ(Open(6).ParamFile(), "/reglages/sdr33.ini");
}

TEST_F(ExportDialog, NothingToExportKeepsTheDialogOpen) {
    const std::vector<int> observations{3 + kObservationReference, 4 + kObservationReference};
    CDlgExportPoints& points = Open(1, true, &observations);
    EXPECT_EQ(points.ScopeChoice(), CDlgExportPoints::kSelected);
    EXPECT_EQ(points.OnOK(frontEnd), ui::DialogResult::Failed);
    EXPECT_EQ(MessageTexts(frontEnd), "Il n'y a rien à exporter !");
    EXPECT_FALSE(fs::exists(dir / "job.txt"));

    // The element formats write the observations selected, unless their box is off.
    CDlgExportPoints& elements = Open(3, true, &observations);
    elements.SetWriteCarnet(false);
    EXPECT_FALSE(elements.HasSomethingToExport());
    elements.SetWriteCarnet(true);
    ASSERT_EQ(elements.OnOK(frontEnd), ui::DialogResult::Ok);
    EXPECT_EQ(ReadBytes(dir / "job.txt"),
              "QUENDAL-PC;1\nSTATION;A1;1.55\nREFERENCE;A007;1.3;12.3456;99.5;14.142\n");
}

TEST_F(ExportDialog, AGeoBaseExportedWholeIsTheSameGeoBase) {
    ASSERT_EQ(Open(0).OnOK(frontEnd), ui::DialogResult::Ok);
    CCarnet copy;
    ASSERT_EQ(copy.Load(nullptr, dir / "job_2.geo"), 1);
    std::string original, exported;
    EXPECT_EQ(copy.GetSize(), carnet.GetSize());
    for (int i = 0; i < carnet.GetSize(); ++i) {
        original += ElementLine(*carnet.GetAt(i), carnet.GetType(i)) + "\n";
        exported += ElementLine(*copy.GetAt(i), copy.GetType(i)) + "\n";
    }
    EXPECT_EQ(exported, original);
}

TEST_F(ExportDialog, AGeoBaseCopyKeepsTheScopeAndTheKindsAsked) {
    // The identifier range: the prefix of both bounds and a number between theirs.
    CDlgExportPoints& range = Open(0);
    range.SetFrom("A1");
    range.SetTo("A9");
    ASSERT_EQ(range.OnOK(frontEnd), ui::DialogResult::Ok);
    EXPECT_EQ(Lines(SavedGeoBase(dir / "job_2.geo")), "1006 A1\n1006 A007\n");

    // The selection, without its points.
    const std::vector<int> selection{1, 3 + kObservationReference, 5 + kObservationReference, 7};
    CDlgExportPoints& selected = Open(0, true, &selection);
    selected.SetWritePoints(false);
    frontEnd.answers = {ui::Answer::Yes}; // replace the former copy
    ASSERT_EQ(selected.OnOK(frontEnd), ui::DialogResult::Ok);
    EXPECT_EQ(Lines(SavedGeoBase(dir / "job_2.geo")), "1001 A1\n1003 A10\n");
    EXPECT_EQ(selected.Written(), 2);
}

TEST_F(ExportDialog, AnExistingFileIsReplacedCompletedOrLeftAsItWas) {
    const std::string out = dir / "job.txt";
    WriteBytes(out, "QUENDAL-PC;1\nPOINT;Z9;1;2;3\n");
    CDlgExportPoints& d = Open(3);
    d.SetWriteCarnet(false);
    frontEnd.answers = {ui::Answer::Cancel};
    EXPECT_EQ(d.OnOK(frontEnd), ui::DialogResult::Cancel);
    EXPECT_EQ(ReadBytes(out), "QUENDAL-PC;1\nPOINT;Z9;1;2;3\n");
    EXPECT_EQ(Read("DernierFormat"), "<absent>"); // nothing done, nothing written back

    frontEnd.answers = {ui::Answer::No}; // "Compléter"
    ASSERT_EQ(d.OnOK(frontEnd), ui::DialogResult::Ok);
    EXPECT_EQ(ReadBytes(out), "QUENDAL-PC;1\nPOINT;Z9;1;2;3\nPOINT;A1;1000;2000;100;BORNE\n"
                              "POINT;A007;1010;2010;101\nPOINT;A10;1020;1990\nPOINT;B5;990;2005;99\n");
    frontEnd.answers = {ui::Answer::Yes}; // "Remplacer"
    ASSERT_EQ(d.OnOK(frontEnd), ui::DialogResult::Ok);
    EXPECT_EQ(ReadBytes(out).substr(0, 27), "QUENDAL-PC;1\nPOINT;A1;1000;");

    // A GéoBase completed keeps its elements first (its points: the box of the observations stayed off).
    ASSERT_EQ(Open(0).OnOK(frontEnd), ui::DialogResult::Ok);
    frontEnd.answers = {ui::Answer::No};
    ASSERT_EQ(Open(0).OnOK(frontEnd), ui::DialogResult::Ok);
    EXPECT_EQ(Lines(SavedGeoBase(dir / "job_2.geo")), "1006 A1\n1006 A007\n1006 A10\n1006 B5\n"
                                                      "1006 A1\n1006 A007\n1006 A10\n1006 B5\n");
}

TEST_F(ExportDialog, ADrawingIsReplacedOrAnotherChosenNeverCompleted) {
    CDlgOverWrite drawing(false);
    EXPECT_EQ(drawing.Lines()[1], "Vous pouvez remplacer le fichier ou en choisir");
    EXPECT_EQ(drawing.Lines()[2], "un autre en appuyant sur Annuler.");
    CDlgOverWriteForm form(drawing);
    EXPECT_FALSE(form.State(CDlgOverWriteForm::kComplete).enabled);
    form.Act(frontEnd, CDlgOverWriteForm::kComplete, {});
    EXPECT_FALSE(form.Ended());
    // At a terminal "Non" is no answer that completes a drawing.
    frontEnd.answers = {ui::Answer::No};
    EXPECT_EQ(drawing.Run(frontEnd), ui::DialogResult::Cancel);
    EXPECT_EQ(drawing.Choice(), OverwriteChoice::Cancel);

    CDlgOverWrite text(true);
    EXPECT_EQ(text.Lines()[0], "Le fichier de points à créer existe déjà !");
    CDlgOverWriteForm textForm(text);
    textForm.Act(frontEnd, CDlgOverWriteForm::kComplete, {});
    EXPECT_EQ(textForm.Ended(), ui::DialogResult::Ok);
    EXPECT_EQ(text.Choice(), OverwriteChoice::Complete);
}

TEST_F(ExportDialog, WrongFieldsAreSaidAndNothingIsWritten) {
    CDlgExportPoints& d = Open(3);
    d.SetFrom("A1");
    d.SetTo("B9");
    EXPECT_EQ(d.OnOK(frontEnd), ui::DialogResult::Failed);
    d.SetTo("A9");
    d.SetOutput("");
    EXPECT_EQ(d.OnOK(frontEnd), ui::DialogResult::Failed);
    EXPECT_EQ(MessageTexts(frontEnd),
              "Plage de matricules incorrecte : les deux bornes de la plage n'ont pas le "
              "même préfixe !|Indiquez le nom du fichier à créer !");
    // A source that is not there: the loading says so.
    CDlgExportPoints& absent = Open(3, false);
    absent.SetSource(dir / "absent.geo");
    EXPECT_EQ(absent.OnOK(frontEnd), ui::DialogResult::Failed);
    EXPECT_FALSE(fs::exists(dir / "absent.txt"));
}

TEST_F(ExportDialog, AGeoBaseWithoutAnythingToWriteMakesNoFile) {
    carnet = CCarnet();
    carnet.SetPathName(geo);
    for (int format : {0, 1, 3, 7}) {
        EXPECT_EQ(Open(format).OnOK(frontEnd), ui::DialogResult::Failed) << format;
        EXPECT_EQ(frontEnd.messages.back().text, "Il n'y a rien à exporter !");
    }
    // Observations only: nothing for a point format, nor for an element format without them.
    carnet.Add(std::make_unique<CStation>("S1", 1.5), kKindStation);
    EXPECT_EQ(Open(1).OnOK(frontEnd), ui::DialogResult::Failed);
    CDlgExportPoints& elements = Open(3);
    elements.SetWriteCarnet(false);
    EXPECT_EQ(elements.OnOK(frontEnd), ui::DialogResult::Failed);
    for (const std::string& name : FileNames(dir.Root()))
        EXPECT_TRUE(name == "inst" || name == "Pyralis.ini") << name;
}

TEST_F(ExportDialog, EveryPointGoesOutInOrderTwinsIncludedAndQuendalGivesBackTheObservations) {
    // A point measured twice keeps both of its elements.
    carnet.Add(std::make_unique<CPointGen>("A1", 1000.002, 1999.998, 100.001), kKindPoint);
    CDlgExportPoints& delimited = Open(1);
    delimited.SetParamFile(std::string(PYR_SOURCE_DIR) + "/data/Config/Param_Export.sep");
    ASSERT_EQ(delimited.OnOK(frontEnd), ui::DialogResult::Ok) << MessageTexts(frontEnd);
    EXPECT_EQ(ReadBytes(dir / "job.txt"),
              "PT;A1;1000;2000;100;BORNE\nPT;A007;1010;2010;101;\nPT;A10;1020;1990;;\n"
              "PT;B5;990;2005;99;\nPT;A1;1000.002;1999.998;100.001;\n");

    frontEnd.answers = {ui::Answer::Yes};
    ASSERT_EQ(Open(3).OnOK(frontEnd), ui::DialogResult::Ok);
    ReaderRun<CQuendalReader> run;
    const CCarnet& read = run.Read(ReadBytes(dir / "job.txt"));
    std::string original, back;
    for (int i = 0; i < carnet.GetSize(); ++i)
        original += ElementLine(*carnet.GetAt(i), carnet.GetType(i)) + "\n";
    for (int i = 0; i < read.GetSize(); ++i)
        back += ElementLine(*read.GetAt(i), read.GetType(i)) + "\n";
    EXPECT_EQ(back, original);
}

TEST_F(ExportDialog, ACommandLineSelectionNamesThePointsAndTheObservationsOfItsIdentifiers) {
    std::string why;
    const auto references = SelectionReferences(carnet, "A1, A10", &why);
    ASSERT_TRUE(references);
    EXPECT_EQ(*references, (std::vector<int>{1, 3 + kObservationReference, 5 + kObservationReference, 6}));
    EXPECT_FALSE(SelectionReferences(carnet, "150-100", &why));

    ASSERT_EQ(carnet.Save(geo), 1);
    CDlgExportPoints d(nullptr, nullptr, 1);
    d.SetInputs({geo, params, dir / "inst/", "export"});
    ExportRequests requests;
    requests.selection = "C1-C9";
    requests.scope = CDlgExportPoints::kSelected;
    EXPECT_EQ(RunExport(d, requests, frontEnd, nullptr), ui::DialogResult::Failed);
    EXPECT_EQ(MessageTexts(frontEnd), "Il n'y a rien à exporter !");
}

} // namespace
} // namespace pyr
