// The windows of the polygonal traverses and of direct levelling driven as a desktop host drives them.
// The traverse is measured by a perfect instrument between two known and oriented stations, the levelling
// run read by a perfect level between two benchmarks: the coordinates and heights written are known
// beforehand.
#include "FormPerson.h"
#include "TestSupport.h"
#include "calc/CalcChemDriver.h"
#include "calc/CalcChemForm.h"
#include "calc/CalcNivDriver.h"
#include "calc/CalcNivForm.h"
#include "calc/IntersectionJob.h"
#include "calc/LevelJob.h"
#include "calc/TraverseJob.h"
#include "core/Strings.h"
#include "geobase/Elements.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace pyr::test {
namespace {

using ui::kIdCancel;
using ui::kIdOk;

constexpr double kTenthMm = 1e-4;

// The cells of a table's line.
std::vector<std::string> Cells(const std::string& line) {
    std::vector<std::string> cells;
    std::size_t from = 0;
    for (std::size_t tab; (tab = line.find('\t', from)) != std::string::npos; from = tab + 1)
        cells.push_back(line.substr(from, tab - from));
    cells.push_back(line.substr(from));
    return cells;
}

CCarnet Load(const std::string& path) {
    CCarnet carnet;
    carnet.Load(nullptr, path);
    return carnet;
}

bool Contains(const std::string& text, std::string_view part) {
    return text.find(part) != std::string::npos;
}

// ---- Polygonal traverses

using namespace traverse_job;

// CH1 goes A - T1 - T2 - B, CH2 the same way back.
struct TraverseJobFile {
    CCarnet job;

    explicit TraverseJobFile(bool withTraverses, double t2Shift = 0.0) {
        TraverseJobOptions options;
        options.t2Shift = t2Shift;
        if (withTraverses) options.traverses = {kTraverseCH1, {"CH2", {"B", "T2", "T1", "A"}}};
        job = TraverseJob(options);
    }

    std::string Prepare(const TempDir& dir) {
        WriteBytes(dir / "Pyralis.ini", kPlainListingOptions);
        job.Save(dir / "chantier.geo");
        return dir / "chantier.geo";
    }
};

class TraverseForm : public ::testing::Test {
protected:
    using F = CCalcChemForm;
    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CCalcChemDriver dialog;
    std::unique_ptr<ui::Form> form;
    std::string geo;

    Person Open(TraverseJobFile job) {
        geo = job.Prepare(dir);
        dialog.SetInputs({geo, dir / "Pyralis.ini", "", ""});
        form = dialog.MakeForm();
        EXPECT_TRUE(form->Open(frontEnd));
        return Person{*form, frontEnd};
    }
};

TEST_F(TraverseForm, TheCheckedTraverseComputedSavedThenFinishedWithTheListing) {
    Person person = Open(TraverseJobFile(true));
    EXPECT_EQ(form->Caption(), "PYRALIS - Calcul de cheminements polygonaux");
    EXPECT_EQ(person[F::kTraverses].items, (std::vector<std::string>{"CH1", "CH2"}));
    EXPECT_TRUE(Contains(person[F::kStatus].text, "aucun coché")) << person[F::kStatus].text;
    EXPECT_FALSE(person[F::kSave].enabled);
    EXPECT_FALSE(person[kIdOk].enabled);

    // Both checked, then CH2 unchecked: CH1 alone is computed.
    person.CheckLine(F::kTraverses, 1, true);
    person.CheckLine(F::kTraverses, 0, true);
    person.CheckLine(F::kTraverses, 1, false);
    EXPECT_EQ(person[F::kTraverses].checks, (std::vector<bool>{true, false}));
    person.Click(F::kCalculate);
    const ui::ControlState results = person[F::kResults];
    ASSERT_EQ(results.items.size(), 1u);
    const std::vector<std::string> cells = Cells(results.items[0]);
    ASSERT_EQ(cells.size(), 10u);
    EXPECT_EQ(cells[0], "CH1");
    EXPECT_EQ(cells[1], "encadré");
    for (int closure : {2, 4, 7}) // fa, f, fz: a perfect instrument closes
        EXPECT_NEAR(std::stod(cells[static_cast<std::size_t>(closure)]), 0.0, 1e-3) << closure;
    EXPECT_EQ(cells[9], "dans les tolérances");
    EXPECT_TRUE(person[F::kSave].enabled);

    person.Click(F::kSave);
    EXPECT_FALSE(person[F::kSave].enabled); // written once
    const CCarnet saved = Load(geo);
    for (const auto& [name, place] : {std::pair{"T1", kT1}, {"T2", kT2}}) {
        SCOPED_TRACE(name);
        const int at = saved.findMat(name);
        ASSERT_GE(at, 0);
        EXPECT_NEAR(saved.xAt(at), place.x, kTenthMm);
        EXPECT_NEAR(saved.yAt(at), place.y, kTenthMm);
        EXPECT_NEAR(saved.zAt(at), place.z, kTenthMm);
    }
    EXPECT_NEAR(saved.v0At(saved.findStaRep("T1", 1)), 210.0, 1e-4);

    person.Click(kIdOk);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Ok);
    EXPECT_TRUE(frontEnd.questions.empty()); // the listing was asked for: no question
    const std::string listing = ReadBytes(dir / "chantier.ccp");
    EXPECT_TRUE(Contains(listing, "Cheminement CH1 : encadré"));
    EXPECT_FALSE(Contains(listing, "CH2"));
}

TEST_F(TraverseForm, OutOfToleranceItIsShownAndClosingWithoutSavingWritesNothing) {
    Person person = Open(TraverseJobFile(true, 0.05)); // T2 seen 5 cm east from T1
    const std::string before = ReadBytes(geo);
    person.Click(F::kCalculate);
    const ui::ControlState results = person[F::kResults];
    ASSERT_EQ(results.items.size(), 2u);
    for (std::size_t line = 0; line < 2; ++line) {
        EXPECT_EQ(Cells(results.items[line]).back(), "HORS TOLÉRANCE");
        EXPECT_TRUE(Contains(results.tips[line], "planimétrique")) << results.tips[line];
    }
    EXPECT_TRUE(Contains(person[F::kStatus].text, "2 hors tolérance")) << person[F::kStatus].text;

    frontEnd.answers = {ui::Answer::No}; // no listing
    person.Click(kIdCancel);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Cancel);
    EXPECT_EQ(frontEnd.questions.size(), 1u);
    EXPECT_EQ(ReadBytes(geo), before);
    EXPECT_FALSE(std::filesystem::exists(dir / "chantier.ccp"));
}

TEST_F(TraverseForm, AGeoBaseWithoutTraversesSaysSoAndTheSearchFindsThem) {
    Person person = Open(TraverseJobFile(false));
    EXPECT_TRUE(person[F::kTraverses].items.empty());
    EXPECT_TRUE(Contains(person[F::kStatus].text, "aucun cheminement")) << person[F::kStatus].text;
    EXPECT_FALSE(person[F::kCalculate].enabled);

    person.Click(F::kSearch);
    EXPECT_EQ(person[F::kTraverses].items, std::vector<std::string>{"CH1"});
    EXPECT_TRUE(Contains(person[F::kStatus].text, "1 cheminement(s) ajouté(s)")) << person[F::kStatus].text;
    EXPECT_GE(Load(geo).Find(kKindChemin, "CH1"), 0); // the search saves what it found
    person.Click(F::kCalculate);
    ASSERT_EQ(person[F::kResults].items.size(), 1u);
    EXPECT_EQ(Cells(person[F::kResults].items[0]).back(), "dans les tolérances");
}

// ---- Direct levelling

namespace lj = level_job;

// The level job, written where the window finds it.
struct LevellingJob : LevelJob {
    std::string Prepare(const TempDir& dir) {
        WriteBytes(dir / "Pyralis.ini", kPlainListingOptions);
        carnet.Save(dir / "chantier.geo");
        return dir / "chantier.geo";
    }
};

double SavedZ(const CCarnet& saved, const char* name) {
    const int at = saved.findMat(name);
    return at >= 0 ? saved.zAt(at) : kUndefined;
}

class LevellingForm : public ::testing::Test {
protected:
    using F = CCalcNivForm;
    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    std::unique_ptr<CCalcNivDriver> dialog;
    std::unique_ptr<ui::Form> form;
    std::string geo;

    bool Open(LevellingJob& job, LevellingMethod method = LevellingMethod::Simple) {
        geo = job.Prepare(dir);
        dialog = std::make_unique<CCalcNivDriver>(method);
        dialog->SetInputs({geo, dir / "Pyralis.ini", "", ""});
        form = dialog->MakeForm();
        return form->Open(frontEnd);
    }
};

TEST_F(LevellingForm, AMisclosureSharedAlongTheRunTheHeightsSavedThenTheListing) {
    LevellingJob job;
    job.SimpleRun(lj::kB + 0.006); // f = -6 mm over three equal set-ups: +2 mm each
    ASSERT_TRUE(Open(job));
    Person person{*form, frontEnd};
    EXPECT_EQ(form->Caption(), "PYRALIS - Calcul de cheminement altimétrique");
    EXPECT_EQ(person[F::kStart].items, (std::vector<std::string>{"(toutes)", "A", "B"}));
    EXPECT_EQ(person[F::kStart].current, 0);
    EXPECT_FALSE(person[F::kSave].enabled);

    person.Select(F::kStart, 1);
    person.Select(F::kEnd, 2);
    EXPECT_EQ(person[F::kStart].current, 1);
    EXPECT_EQ(person[F::kEnd].current, 2);
    person.Click(F::kCalculate);
    const ui::ControlState results = person[F::kResults];
    ASSERT_EQ(results.items.size(), 1u);
    const std::vector<std::string> cells = Cells(results.items[0]);
    ASSERT_EQ(cells.size(), 7u);
    EXPECT_EQ(cells[0], "A");
    EXPECT_EQ(cells[1], "B");
    EXPECT_EQ(cells[2], "3");
    EXPECT_NEAR(std::stod(cells[3]), 180.0, 1e-3);
    EXPECT_EQ(cells[4], "-0.0060");
    EXPECT_EQ(cells[5], "0.0100");
    EXPECT_EQ(cells[6], "dans la tolérance");
    EXPECT_TRUE(person[F::kProblems].items.empty());

    person.Click(F::kSave);
    const CCarnet saved = Load(geo);
    EXPECT_NEAR(SavedZ(saved, "T1"), lj::kT1 + 0.002, kTenthMm);
    EXPECT_NEAR(SavedZ(saved, "T2"), lj::kT2 + 0.004, kTenthMm);
    EXPECT_NEAR(SavedZ(saved, "S"), lj::kS + 0.002, kTenthMm);
    EXPECT_NEAR(SavedZ(saved, "B"), lj::kB + 0.006, kTenthMm); // the benchmarks keep theirs

    person.Click(kIdOk);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Ok);
    EXPECT_TRUE(Contains(ReadBytes(dir / "chantier.cns"), "Cheminement altimétrique de A à B"));
}

TEST_F(LevellingForm, AChoiceThatMatchesNoRunAndWhatReachesNoBenchmarkAreSaid) {
    LevellingJob job;
    job.SimpleRun(lj::kB);
    job.SetUp("B", lj::kB, "X", 101.0); // levelled on from B to a point of unknown height
    ASSERT_TRUE(Open(job));
    Person person{*form, frontEnd};
    const std::string before = ReadBytes(geo);

    person.Select(F::kStart, 2); // B: no run leaves it
    person.Click(F::kCalculate);
    EXPECT_TRUE(person[F::kResults].items.empty());
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_TRUE(Contains(frontEnd.messages[0].text, "départ B")) << frontEnd.messages[0].text;
    ASSERT_EQ(person[F::kProblems].items.size(), 1u);
    EXPECT_TRUE(Contains(person[F::kProblems].items[0], "parti de B")) << person[F::kProblems].items[0];
    EXPECT_FALSE(person[F::kSave].enabled);
    EXPECT_FALSE(person[kIdOk].enabled);

    person.Select(F::kStart, 0); // any
    person.Click(F::kCalculate);
    ASSERT_EQ(person[F::kResults].items.size(), 1u);
    EXPECT_TRUE(
        Contains(person[F::kStatus].text, "1 cheminement(s) calculé(s), 0 hors tolérance, 1 remarque"))
        << person[F::kStatus].text;

    frontEnd.answers = {ui::Answer::No}; // no listing
    person.Click(kIdCancel);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Cancel);
    EXPECT_EQ(ReadBytes(geo), before);
    EXPECT_FALSE(std::filesystem::exists(dir / "chantier.cns"));
}

TEST_F(LevellingForm, DoubleStationShowsThePairOutOfToleranceAndWritesOnlyWhenTold) {
    LevellingJob job;
    job.Benchmark("A", lj::kA);
    job.Benchmark("B", lj::kB);
    job.SetUp("A", lj::kA, "T1", lj::kT1 + 0.001, 1.4);
    job.SetUp("A", lj::kA, "T1", lj::kT1 - 0.001, 1.6);
    job.SetUp("T1", lj::kT1, "B", lj::kB + 0.015, 1.3); // 30 mm between the two: over 10 mm
    job.SetUp("T1", lj::kT1, "B", lj::kB - 0.015, 1.7);
    ASSERT_TRUE(Open(job, LevellingMethod::DoubleStation));
    Person person{*form, frontEnd};
    EXPECT_EQ(form->Caption(), "PYRALIS - Calcul de nivellement par double station");
    person.Click(F::kCalculate);
    const ui::ControlState results = person[F::kResults];
    ASSERT_EQ(results.items.size(), 1u);
    const std::vector<std::string> cells = Cells(results.items[0]);
    EXPECT_EQ(cells[2], "4"); // four set-ups of the level, two steps
    EXPECT_EQ(cells.back(), "dénivelées mal contrôlées");
    EXPECT_TRUE(Contains(results.tips[0], "T1 à B")) << results.tips[0];

    frontEnd.answers = {ui::Answer::No}; // not written
    person.Click(F::kSave);
    EXPECT_FALSE(IsKnown(SavedZ(Load(geo), "T1")));
}

TEST_F(LevellingForm, AGeoBaseWithoutStaffReadingsSaysSoAndTheWindowDoesNotOpen) {
    LevellingJob job;
    job.Benchmark("A", lj::kA);
    EXPECT_FALSE(Open(job));
    EXPECT_EQ(form->Ended(), ui::DialogResult::Failed);
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_TRUE(Contains(frontEnd.messages[0].text, "aucune lecture sur mire")) << frontEnd.messages[0].text;
}

} // namespace
} // namespace pyr::test
