// The computations' dialogs used as a person uses them, through their widgets: the point or the V0 found
// is the one the geometry gives, and the same as the same actions on the model give. The GéoBases are
// built from exact coordinates.
#include "Capture.h"
#include "FormDialog.h"
#include "TestSupport.h"
#include "calc/CalcChemDriver.h"
#include "calc/CalcInters.h"
#include "calc/CalcIntersDriver.h"
#include "calc/CalcNivDriver.h"
#include "calc/CalcRayonDriver.h"
#include "calc/CalculV0Driver.h"
#include "calc/IntersectionJob.h"
#include "calc/ResectionDriver.h"
#include "calc/TraverseJob.h"
#include "settings/OptionPages.h"
#include "ui/Form.h"
#include "ui/ScriptedFrontEnd.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QTabWidget>
#include <QTest>
#include <QTreeWidget>
#include <gtest/gtest.h>

namespace pyr::test {
namespace {

constexpr double kTenthMm = 1e-4;

// The dialog as the person sees it at that moment, kept beside the pictures of the build for a review.
void Picture(QWidget& dialog, const char* name) {
    const QString folder = QT_TESTCASE_BUILDDIR "/../captures";
    QDir().mkpath(folder);
    EXPECT_TRUE(bureau::SaveCapture(dialog, folder + "/" + name));
}

template <class Widget>
Widget& Find(QWidget& dialog, const char* name) {
    auto* widget = dialog.findChild<Widget*>(name);
    if (!widget) throw std::runtime_error(std::string("pas de contrôle ") + name);
    return *widget;
}

void Click(QWidget& dialog, const char* name) {
    auto& button = Find<QPushButton>(dialog, name);
    EXPECT_TRUE(button.isEnabled()) << name;
    QTest::mouseClick(&button, Qt::LeftButton);
}

class DialogWidgets : public ::testing::Test {
protected:
    // The form of `driver` on that GéoBase, shown as the person sees it.
    bool Show(std::unique_ptr<ui::Dialog> driver, const std::string& geo, const char* title) {
        model = std::move(driver);
        model->SetInputs({geo, dir / "Pyralis.ini", "", title});
        form = model->MakeForm();
        if (!form->Open(frontEnd)) return false;
        dialog = std::make_unique<bureau::FormDialog>(*form, frontEnd);
        dialog->show();
        return QTest::qWaitForWindowActive(dialog.get());
    }

    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    std::unique_ptr<ui::Dialog> model;
    std::unique_ptr<ui::Form> form;
    std::unique_ptr<bureau::FormDialog> dialog; // closed before its form and its model
};

TEST_F(DialogWidgets, APointIsComputedWrittenAndListedThroughTheIntersectionDialog) {
    IntersectionJob job;
    const std::string geo = job.Prepare(dir);
    ASSERT_TRUE(
        Show(std::make_unique<CCalcIntersDriver>(), geo, "calcul d'un point par intersections de visées"));

    // The point's name typed into the combo, then every sighting taken.
    auto& point = Find<QComboBox>(*dialog, "sujet");
    point.setFocus();
    point.lineEdit()->selectAll();
    QTest::keyClicks(point.lineEdit(), "P");
    QTest::keyClick(point.lineEdit(), Qt::Key_Return);
    EXPECT_EQ(Find<QListWidget>(*dialog, "disponibles").count(), 3);
    EXPECT_FALSE(Find<QPushButton>(*dialog, "ecrire").isEnabled());
    Click(*dialog, "ajouterToutes");
    EXPECT_EQ(Find<QListWidget>(*dialog, "retenues").count(), 3);
    EXPECT_EQ(Find<QLineEdit>(*dialog, "valeurPremiere").text().toStdString(), "1050.0000");
    EXPECT_EQ(Find<QLineEdit>(*dialog, "valeurSeconde").text().toStdString(), "2080.0000");

    // Planimetry switched off leaves the altitude alone, and back on.
    Find<QCheckBox>(*dialog, "calculPlani").click();
    EXPECT_EQ(Find<QLineEdit>(*dialog, "valeurPremiere").text().toStdString(), "");
    Find<QCheckBox>(*dialog, "calculPlani").click();

    Picture(*dialog, "CalInter-point-calcule.png");
    Click(*dialog, "ecrire");
    frontEnd.answers = {ui::Answer::Yes}; // the modified GéoBase saved on leaving
    Click(*dialog, "finListing");
    EXPECT_EQ(dialog->Result(), ui::DialogResult::Ok);
    CCarnet saved;
    saved.Load(nullptr, geo);
    const int p = saved.findMat("P");
    ASSERT_GE(p, 0);
    EXPECT_NEAR(saved.xAt(p), IntersectionJob::kP.x, kTenthMm);
    EXPECT_NEAR(saved.yAt(p), IntersectionJob::kP.y, kTenthMm);
    EXPECT_NEAR(saved.zAt(p), IntersectionJob::kP.z, kTenthMm);
    EXPECT_NE(ReadBytes(dir / "chantier.cin").find("Calcul du point P"), std::string::npos);

    // The same actions on the model leave the same GéoBase.
    EXPECT_EQ(IntersectionJob::ByTheModel(frontEnd), ReadBytes(geo));
}

TEST_F(DialogWidgets, AStationIsOrientedThroughTheV0Dialog) {
    // S1 at a V0 of 50 gr on four known points.
    const Place s1{1000.0, 2000.0, 100.0};
    const Place a{1100.0, 2100.0, 101.0}, b{900.0, 2150.0, 99.0}, c{950.0, 1850.0, 100.5},
        d{1150.0, 1950.0, 98.0};
    CCarnet job;
    AddPoint(job, "S1", s1);
    for (const auto& [name, place] : {std::pair{"A", a}, {"B", b}, {"C", c}, {"D", d}})
        AddPoint(job, name, place);
    AddStation(job, "S1", 1.5, kUndefined);
    for (const auto& [name, place] : {std::pair{"A", a}, {"B", b}, {"C", c}, {"D", d}})
        AddSighting(job, name, s1, 1.5, place, 1.3, 50.0, kKindReference);
    WriteBytes(dir / "Pyralis.ini", kPlainListingOptions);
    ASSERT_EQ(job.Save(dir / "chantier.geo"), 1);
    ASSERT_TRUE(
        Show(std::make_unique<CCalculV0Driver>(), dir / "chantier.geo", "calcul du V0 d'une station"));
    EXPECT_EQ(Find<QListWidget>(*dialog, "references").count(), 4);
    Click(*dialog, "calculer");
    EXPECT_NEAR(Find<QLineEdit>(*dialog, "v0").text().toDouble(), 50.0, 1e-4);
    Picture(*dialog, "CalculV0-station-orientee.png");
    frontEnd.answers = {ui::Answer::No}; // no listing
    Click(*dialog, "enregistrer");
    EXPECT_EQ(dialog->Result(), ui::DialogResult::Ok);
    CCarnet saved;
    saved.Load(nullptr, dir / "chantier.geo");
    const int station = saved.findStaRep("S1", 1);
    ASSERT_GE(station, 0);
    EXPECT_NEAR(saved.v0At(station), 50.0, 1e-4);
}

TEST_F(DialogWidgets, AStationIsComputedAndWrittenThroughTheCombinedDialog) {
    // E, unknown, sights A, B and C; S, set up on A and oriented, sights E.
    const Place e{1040.0, 2030.0, 101.5};
    const Place a{1000.0, 2100.0, 100.0}, b{1120.0, 2080.0, 102.0}, c{1090.0, 1950.0, 99.0};
    CCarnet job;
    for (const auto& [name, place] : {std::pair{"A", a}, {"B", b}, {"C", c}})
        AddPoint(job, name, place);
    AddStation(job, "E", 1.55);
    for (const auto& [name, place] : {std::pair{"A", a}, {"B", b}, {"C", c}})
        AddSighting(job, name, e, 1.55, place, 1.3, 37.5);
    AddStation(job, "A", 1.6, 50.0);
    AddSighting(job, "E", a, 1.6, e, 1.4, 50.0, kKindMesure);
    WriteBytes(dir / "Pyralis.ini", kPlainListingOptions);
    ASSERT_EQ(job.Save(dir / "chantier.geo"), 1);
    ASSERT_TRUE(Show(std::make_unique<CCalcRecoupDriver>(), dir / "chantier.geo",
                     "calcul d'un point par recoupement"));
    auto& station = Find<QComboBox>(*dialog, "sujet");
    ASSERT_EQ(station.count(), 1);
    EXPECT_EQ(station.itemText(0).toStdString(), "E (1)");
    station.setFocus();
    station.lineEdit()->selectAll();
    QTest::keyClicks(station.lineEdit(), "E");
    QTest::keyClick(station.lineEdit(), Qt::Key_Return);
    auto& available = Find<QListWidget>(*dialog, "disponibles");
    ASSERT_EQ(available.count(), 4);
    EXPECT_EQ(available.item(0)->text().toStdString(), "---> A");
    EXPECT_EQ(available.item(3)->text().toStdString(), "<--- A (1)");
    Click(*dialog, "ajouterToutes");
    EXPECT_NEAR(Find<QLineEdit>(*dialog, "valeurPremiere").text().toDouble(), e.x, kTenthMm);
    EXPECT_NEAR(Find<QLineEdit>(*dialog, "valeurSeconde").text().toDouble(), e.y, kTenthMm);
    EXPECT_NEAR(Find<QLineEdit>(*dialog, "valeurV0").text().toDouble(), 37.5, 1e-4);
    EXPECT_EQ(dialog->windowTitle().toStdString(), "Calcul de la station E par recoupement");
    Picture(*dialog, "CalRecou-station-calculee.png");
    Click(*dialog, "ecrire");
    frontEnd.answers = {ui::Answer::Yes, ui::Answer::No}; // saved, no listing
    Click(*dialog, "fermer");
    CCarnet saved;
    saved.Load(nullptr, dir / "chantier.geo");
    const int point = saved.findMat("E");
    ASSERT_GE(point, 0);
    EXPECT_NEAR(saved.xAt(point), e.x, kTenthMm);
    EXPECT_NEAR(saved.zAt(point), e.z, kTenthMm);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("E", 1)), 37.5, 1e-4);
}

// The demonstration job, its stations oriented on their references first: the three detail points each
// seen from two or three set-ups, the known points checked.
TEST_F(DialogWidgets, EveryStationOfTheDemoRadiatedThroughTheRadiationDialog) {
    std::filesystem::copy_file(std::string(PYR_SOURCE_DIR) + "/data/chantier-demo.geo", dir / "chantier.geo");
    WriteBytes(dir / "Pyralis.ini",
               std::string(kPlainListingOptions) + "[Options_Calculs]\nRayonV0Calcule=1\n");
    ASSERT_TRUE(
        Show(std::make_unique<CCalcRayonDriver>(), dir / "chantier.geo", "calcul des points rayonnés"));
    QTest::mouseClick(&Find<QRadioButton>(*dialog, "toutes"), Qt::LeftButton);
    EXPECT_FALSE(Find<QComboBox>(*dialog, "station").isEnabled());
    Click(*dialog, "calculer");
    auto& points = Find<QTreeWidget>(*dialog, "resultats");
    ASSERT_EQ(points.topLevelItemCount(), 3);
    EXPECT_EQ(points.topLevelItem(0)->text(0).toStdString(), "100");
    EXPECT_EQ(points.topLevelItem(0)->text(4).toStdString(), "2");
    Picture(*dialog, "CalRayon-calcule.png");
    frontEnd.answers = {ui::Answer::No}; // no listing
    Click(*dialog, "enregistrer");
    CCarnet saved;
    saved.Load(nullptr, dir / "chantier.geo");
    const int point = saved.findMat("100");
    ASSERT_GE(point, 0);
    EXPECT_NEAR(saved.xAt(point), points.topLevelItem(0)->text(1).toDouble(), kTenthMm);
    EXPECT_GE(saved.v0At(saved.findStaRep("S2", 1)), 0.0);
}

// The traverse CH1 measured by a perfect instrument and CH2, the same stations the other way: both close,
// the stations written.
TEST_F(DialogWidgets, TwoTraversesComputedAndWrittenThroughTheTraverseDialog) {
    TraverseJobOptions options;
    options.traverses = {kTraverseCH1, {"CH2", {"B", "T2", "T1", "A"}}};
    WriteBytes(dir / "Pyralis.ini", kPlainListingOptions);
    ASSERT_EQ(TraverseJob(options).Save(dir / "chantier.geo"), 1);
    ASSERT_TRUE(Show(std::make_unique<CCalcChemDriver>(), dir / "chantier.geo",
                     "calcul des cheminements polygonaux"));
    EXPECT_EQ(Find<QListWidget>(*dialog, "cheminements").count(), 2);
    Click(*dialog, "calculer");
    auto& results = Find<QTreeWidget>(*dialog, "resultats");
    ASSERT_EQ(results.topLevelItemCount(), 2);
    EXPECT_EQ(results.topLevelItem(0)->text(0).toStdString(), "CH1");
    EXPECT_EQ(results.topLevelItem(1)->text(1).toStdString(), "encadré");
    Picture(*dialog, "CalChem-calcule.png");
    Click(*dialog, "enregistrer");
    frontEnd.answers = {ui::Answer::No}; // no listing
    Click(*dialog, "fermer");
    CCarnet saved;
    saved.Load(nullptr, dir / "chantier.geo");
    const int t2 = saved.findMat("T2");
    ASSERT_GE(t2, 0);
    EXPECT_NEAR(saved.xAt(t2), traverse_job::kT2.x, kTenthMm);
}

// A level run BM1 - T1 - T2 - BM2 with a side reading on S from T1, 3 mm short of BM2.
TEST_F(DialogWidgets, ALevelRunComputedThroughTheLevellingDialog) {
    CCarnet job;
    job.Add(std::make_unique<CPointGen>("BM1", 100.0), kKindPoint);
    job.Add(std::make_unique<CPointGen>("BM2", 100.677), kKindPoint);
    const auto back = [&](const char* point, double reading) {
        job.Add(std::make_unique<CLectAR>(point, reading, 30.0), kKindLectAR);
    };
    const auto forward = [&](const char* point, double reading) {
        job.Add(std::make_unique<CLectAV>(point, reading, 30.0), kKindLectAV);
    };
    back("BM1", 1.452), forward("T1", 0.988);
    back("T1", 1.321), forward("S", 1.7), forward("T2", 1.111);
    back("T2", 1.2), forward("BM2", 1.2);
    WriteBytes(dir / "Pyralis.ini", kPlainListingOptions);
    ASSERT_EQ(job.Save(dir / "chantier.geo"), 1);
    ASSERT_TRUE(Show(std::make_unique<CCalcNivDriver>(LevellingMethod::Simple), dir / "chantier.geo",
                     "calcul d'un cheminement altimétrique simple"));
    Click(*dialog, "calculer");
    auto& results = Find<QTreeWidget>(*dialog, "resultats");
    ASSERT_EQ(results.topLevelItemCount(), 1);
    EXPECT_EQ(results.topLevelItem(0)->text(0).toStdString(), "BM1");
    EXPECT_EQ(results.topLevelItem(0)->text(4).toStdString(), "-0.0030");
    Picture(*dialog, "CalNivSm-calcule.png");
    Click(*dialog, "enregistrer");
    frontEnd.answers = {ui::Answer::No}; // no listing
    Click(*dialog, "fermer");
    CCarnet saved;
    saved.Load(nullptr, dir / "chantier.geo");
    EXPECT_NEAR(saved.zAt(saved.findMat("T1")), 100.465, 0.0005); // 100.464 + 1 mm
}

TEST_F(DialogWidgets, AValueTypedOnAPageOfTheOptionsThenOkWritesWhatThePageWouldWrite) {
    const std::string params = dir / "Pyralis.ini";
    WriteBytes(params, "; réglages du cabinet\n");
    ASSERT_TRUE(Show(std::make_unique<COptionPSheet>(), "", "options des calculs topométriques."));

    auto& pages = Find<QTabWidget>(*dialog, "pages");
    pages.setCurrentIndex(2);
    auto& radius = Find<QLineEdit>(*dialog, "Options_Corrections/RayonTerre");
    radius.setFocus();
    radius.selectAll();
    QTest::keyClicks(&radius, "6378.5");
    // A value out of the limits is said, and the field keeps its value.
    auto& length = Find<QLineEdit>(*dialog, "Listings/LongueurPage");
    pages.setCurrentIndex(5);
    length.setFocus(); // leaving the radius commits it
    length.selectAll();
    QTest::keyClicks(&length, "-4");
    QTest::keyClick(&length, Qt::Key_Tab);
    EXPECT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_NE(length.text(), "-4");
    Click(*dialog, "ok");
    EXPECT_EQ(dialog->Result(), ui::DialogResult::Ok);
    const std::string byWindow = ReadBytes(params);

    WriteBytes(params, "; réglages du cabinet\n");
    COptionPSheet bySet;
    bySet.SetInputs({"", params, "", ""});
    ASSERT_EQ(bySet.Regler("Options_Corrections/RayonTerre=6378.5"), "");
    ASSERT_TRUE(bySet.OnOK());
    EXPECT_EQ(ReadBytes(params), byWindow);
}

} // namespace
} // namespace pyr::test
