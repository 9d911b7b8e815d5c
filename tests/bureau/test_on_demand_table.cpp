// A dialog holding a table of a million lines given on demand and the drawing of a small GéoBase: the
// table asks the form only for the lines it shows, sends the lines the person selects and shows those
// the form selects; the drawing sends the element clicked and shows the elements the form selects.
#include "Capture.h"
#include "FormDialog.h"
#include "GeoView.h"
#include "OnDemandTableModel.h"
#include "editor/GeoScene.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "ui/ScriptedFrontEnd.h"

#include <QDir>
#include <QHeaderView>
#include <QScrollBar>
#include <QTableView>
#include <QTest>
#include <QTreeWidget>
#include <gtest/gtest.h>
#include <memory>
#include <numeric>

namespace {

using namespace pyr::ui;
using pyr::bureau::FormDialog;
using pyr::bureau::GeoView;
using pyr::bureau::OnDemandTableModel;

class LinesModel : public DialogModel {
public:
    void Change() { Notify(1); }
};

enum : int { kLines = 10, kDrawing };

// A control point A1, a point S1 with a station set up on it, a computed point P1; the station sights
// both. Elements: 0 A1, 1 S1, 2 P1, 3 the station, 4 the sighting of A1, 5 the sighting of P1.
std::unique_ptr<pyr::GeoScene> SmallJob() {
    pyr::CCarnet carnet;
    carnet.Add(std::make_unique<pyr::CPointGen>("A1", 1000.0, 2000.0, 50.0), pyr::kKindPoint);
    carnet.Add(std::make_unique<pyr::CPointGen>("S1", 1100.0, 2050.0, 51.0), pyr::kKindPoint);
    carnet.Add(std::make_unique<pyr::CPointGen>("P1", 1050.0, 2080.0), pyr::kKindPoint);
    carnet.Add(std::make_unique<pyr::CStation>("S1", 1.5), pyr::kKindStation);
    carnet.Add(std::make_unique<pyr::CReference>("A1", 0.0), pyr::kKindReference);
    carnet.Add(std::make_unique<pyr::CMesure>("P1", 100.0), pyr::kKindMesure);
    return std::make_unique<pyr::GeoScene>(carnet);
}
constexpr int kElementP1 = 2, kElementStation = 3;

// A list of a million points, "P<rank>" with their coordinates, and the drawing of the small job. It
// counts the lines it is asked for and keeps every action.
class LinesForm : public Form {
public:
    DialogModel& Model() override { return model; }
    std::string Caption() override { return "Points du chantier"; }
    std::vector<Control> Controls() const override {
        using enum ControlKind;
        // clang-format off
        return {
            {.id = kLines, .kind = List, .name = "lignes", .columns = {"Point", "X", "Y"}, .lines = 12,
             .onDemand = true, .multiple = true},
            {.id = kDrawing, .kind = Drawing, .name = "dessin", .column = 1},
            {.id = kIdOk, .kind = Button, .name = "ok", .text = "OK", .parent = kButtonRow, .isDefault = true},
            {.id = kIdCancel, .kind = Button, .name = "annuler", .text = "Annuler", .parent = kButtonRow},
        };
        // clang-format on
    }
    bool Open(FrontEnd&) override { return true; }
    ControlState State(int id) const override {
        ControlState state;
        if (id == kLines) {
            state.revision = linesRevision;
            state.current = current;
            state.selection = selection;
        } else if (id == kDrawing) {
            state.revision = sceneRevision;
            state.selection = elements;
        }
        return state;
    }
    void Act(FrontEnd&, int id, const Event& event) override {
        events.push_back({id, event});
        if (id == kLines && event.kind == EventKind::Select) {
            current = event.rank;
            selection = event.ranks;
        }
        if (id == kDrawing && event.kind == EventKind::Select) elements = event.ranks;
        if (id == kIdOk || id == kIdCancel) End(id == kIdOk ? DialogResult::Ok : DialogResult::Cancel);
    }
    int OnDemandRows(int id) const override { return id == kLines ? rows : 0; }
    std::string OnDemandRow(int id, int rank) const override {
        EXPECT_EQ(id, kLines);
        EXPECT_TRUE(rank >= 0 && rank < rows) << rank;
        ++asked;
        return prefix + std::to_string(rank) + "\t" + std::to_string(600000 + rank) + ".125\t6800000.500";
    }
    const pyr::GeoScene* Scene(int id) const override { return id == kDrawing ? scene.get() : nullptr; }

    LinesModel model;
    int rows = 1'000'000;
    std::string prefix = "P";
    long linesRevision = 1;
    int current = -1;
    std::vector<int> selection;
    std::unique_ptr<pyr::GeoScene> scene = SmallJob();
    long sceneRevision = 1;
    std::vector<int> elements;
    mutable long asked = 0;
    std::vector<std::pair<int, Event>> events;
};

class OnDemandDialog : public testing::Test {
protected:
    OnDemandDialog() {
        dialog.resize(900, 420);
        dialog.show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(&dialog));
        table = dialog.findChild<QTableView*>("lignes");
        view = dialog.findChild<GeoView*>("dessin");
        EXPECT_TRUE(table && view);
    }
    // Draws the dialog as the screen would, so that the table asks for the lines it shows.
    void Paint() { (void)dialog.grab(); }
    QPoint RowCentre(int rank) const { return table->visualRect(table->model()->index(rank, 0)).center(); }
    void Click(int rank, Qt::KeyboardModifiers modifiers = {}) {
        QTest::mouseClick(table->viewport(), Qt::LeftButton, modifiers, RowCentre(rank));
    }
    std::vector<int> SelectedRows() const {
        std::vector<int> rows;
        for (const QModelIndex& index : table->selectionModel()->selectedRows())
            rows.push_back(index.row());
        std::sort(rows.begin(), rows.end());
        return rows;
    }

    LinesForm form;
    ScriptedFrontEnd frontEnd;
    FormDialog dialog{form, frontEnd};
    QTableView* table = nullptr;
    GeoView* view = nullptr;
};

TEST_F(OnDemandDialog, AMillionLinesAskOnlyForTheLinesSeen) {
    ASSERT_TRUE(table);
    EXPECT_EQ(table->model()->rowCount(), 1'000'000);
    // The columns sized on the first lines, the lines drawn: a few dozen lines, not a million.
    Paint();
    EXPECT_GT(form.asked, 0);
    EXPECT_LE(form.asked, 200);
    const long shown = form.asked;
    // Drawn again unchanged, the lines kept serve.
    Paint();
    EXPECT_EQ(form.asked, shown);

    table->scrollToBottom();
    Paint();
    EXPECT_LE(form.asked, shown + 100);
    const QModelIndex last = table->model()->index(999'999, 0);
    EXPECT_TRUE(table->viewport()->rect().intersects(table->visualRect(last)));
    EXPECT_EQ(last.data().toString(), "P999999");
    EXPECT_EQ(last.siblingAtColumn(1).data().toString(), "1599999.125");
    // A number on the right, a name on the left.
    const auto alignment = [](const QModelIndex& index) {
        return index.data(Qt::TextAlignmentRole).value<Qt::Alignment>() & Qt::AlignHorizontal_Mask;
    };
    EXPECT_EQ(alignment(last), Qt::AlignLeft);
    EXPECT_EQ(alignment(last.siblingAtColumn(2)), Qt::AlignRight);
    // Every line the same height, known without asking.
    EXPECT_EQ(table->verticalHeader()->sectionResizeMode(0), QHeaderView::Fixed);
}

TEST_F(OnDemandDialog, ANewRevisionAsksForTheLinesAgain) {
    ASSERT_TRUE(table);
    table->scrollToBottom();
    Paint();
    // The list shrinks to ten lines whose names changed: the count and the lines are asked again, and
    // nothing beyond the new end is asked for (the form checks the ranks).
    form.rows = 10;
    form.prefix = "Q";
    form.linesRevision = 2;
    form.model.Change();
    QCoreApplication::processEvents();
    Paint();
    EXPECT_EQ(table->model()->rowCount(), 10);
    EXPECT_EQ(table->model()->index(3, 0).data().toString(), "Q3");
    // The same revision shown again after another action asks for nothing.
    form.prefix = "R";
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_EQ(table->model()->index(3, 0).data().toString(), "Q3");
    form.linesRevision = 3;
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_EQ(table->model()->index(3, 0).data().toString(), "R3");
}

TEST_F(OnDemandDialog, TheLinesSelectedAreSentInOrder) {
    ASSERT_TRUE(table);
    Click(2);
    Click(5, Qt::ShiftModifier);
    ASSERT_FALSE(form.events.empty());
    Event last = form.events.back().second;
    EXPECT_EQ(form.events.back().first, kLines);
    EXPECT_EQ(last.kind, EventKind::Select);
    EXPECT_EQ(last.rank, 5);
    EXPECT_EQ(last.ranks, (std::vector<int>{2, 3, 4, 5}));
    // A line added with Ctrl, then one of the run taken away.
    Click(8, Qt::ControlModifier);
    EXPECT_EQ(form.events.back().second.ranks, (std::vector<int>{2, 3, 4, 5, 8}));
    Click(3, Qt::ControlModifier);
    EXPECT_EQ(form.events.back().second.ranks, (std::vector<int>{2, 4, 5, 8}));
    EXPECT_EQ(SelectedRows(), (std::vector<int>{2, 4, 5, 8}));

    // Everything at once: one action holding every line.
    const std::size_t before = form.events.size();
    table->setFocus();
    QTest::keyClick(table, Qt::Key_A, Qt::ControlModifier);
    ASSERT_EQ(form.events.size(), before + 1);
    const std::vector<int>& all = form.events.back().second.ranks;
    ASSERT_EQ(all.size(), 1'000'000u);
    EXPECT_EQ(all.front(), 0);
    EXPECT_EQ(all.back(), 999'999);
    EXPECT_TRUE(std::is_sorted(all.begin(), all.end()));
}

TEST_F(OnDemandDialog, TheFormsSelectionIsShownWithoutBeingSentBack) {
    ASSERT_TRUE(table);
    Paint();
    form.selection = {500'000, 500'001, 500'002, 700'000};
    form.current = 500'001;
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_TRUE(form.events.empty());
    EXPECT_EQ(SelectedRows(), form.selection);
    EXPECT_EQ(table->currentIndex().row(), 500'001);
    // Brought into view, with only the lines around it asked for.
    const long asked = form.asked;
    Paint();
    EXPECT_TRUE(table->viewport()->rect().contains(RowCentre(500'001)));
    EXPECT_LE(form.asked, asked + 100);
    // New lines with the same current one: the person's scrolling stays.
    table->scrollToTop();
    ++form.linesRevision;
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_EQ(table->currentIndex().row(), 500'001);
    EXPECT_EQ(SelectedRows(), form.selection);
    EXPECT_EQ(table->verticalScrollBar()->value(), 0);

    // The form clears it.
    form.selection.clear();
    form.current = -1;
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_TRUE(SelectedRows().empty());
    EXPECT_TRUE(form.events.empty());
}

TEST_F(OnDemandDialog, TheDrawingSendsTheElementClickedAndShowsTheFormsSelection) {
    ASSERT_TRUE(view);
    ASSERT_EQ(view->Scene().Points().size(), 3u);
    ASSERT_EQ(view->Scene().Stations().size(), 1u);
    EXPECT_EQ(view->Scene().Stations()[0].element, kElementStation);

    QTest::mouseClick(view, Qt::LeftButton, {}, view->ToScreen(1050, 2080).toPoint() + QPoint(1, 2));
    ASSERT_FALSE(form.events.empty());
    EXPECT_EQ(form.events.back().first, kDrawing);
    EXPECT_EQ(form.events.back().second.kind, EventKind::Select);
    EXPECT_EQ(form.events.back().second.rank, kElementP1);
    EXPECT_EQ(form.events.back().second.ranks, (std::vector<int>{kElementP1}));
    // The form's selection comes back to the view: P1 ringed and the sighting aimed at it marked.
    EXPECT_EQ(view->SelectedPoints(), (std::vector<int>{2}));
    ASSERT_EQ(view->SelectedSightings().size(), 1u);
    EXPECT_EQ(view->Scene().Sightings()[static_cast<std::size_t>(view->SelectedSightings()[0])].target, 2);

    // A click on empty ground chooses nothing.
    const QPointF empty = view->ToScreen(1010, 2070);
    QTest::mouseClick(view, Qt::LeftButton, {}, empty.toPoint());
    EXPECT_EQ(form.events.back().second.rank, -1);
    EXPECT_TRUE(form.events.back().second.ranks.empty());
    EXPECT_TRUE(view->SelectedPoints().empty());

    // The station chosen by the form: it and both its sightings.
    const std::size_t before = form.events.size();
    form.elements = {kElementStation};
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_EQ(form.events.size(), before);
    EXPECT_EQ(view->SelectedStations(), (std::vector<int>{0}));
    EXPECT_EQ(view->SelectedSightings(), (std::vector<int>{0, 1}));

    // An edit shown again keeps the person's zoom; no scene at all empties the view.
    view->SetView(1060.0, 2050.0, 8.0);
    form.scene = SmallJob();
    ++form.sceneRevision;
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_DOUBLE_EQ(view->Scale(), 8.0);
    EXPECT_DOUBLE_EQ(view->CentreX(), 1060.0);
    EXPECT_EQ(view->SelectedSightings(), (std::vector<int>{0, 1}));
    form.scene.reset();
    ++form.sceneRevision;
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_TRUE(view->Scene().IsEmpty());
}

// A list whose lines are in its state may be of several lines too: the same selection both ways, kept
// when the lines are given again.
TEST(SeveralLinesOfAList, AreSelectedBothWays) {
    struct Few : LinesForm {
        std::vector<Control> Controls() const override {
            return {{.id = kLines,
                     .kind = ControlKind::List,
                     .name = "peu",
                     .columns = {"Point", "Z"},
                     .multiple = true}};
        }
        ControlState State(int id) const override {
            ControlState state = LinesForm::State(id);
            state.items = {"A\t1.5", "B\t2.5", "C\t3.5", "D\t4.5"};
            return state;
        }
    } form;
    ScriptedFrontEnd frontEnd;
    form.selection = {1, 3};
    FormDialog dialog(form, frontEnd);
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&dialog));
    auto* list = dialog.findChild<QTreeWidget*>("peu");
    ASSERT_TRUE(list);
    auto selected = [&] {
        std::vector<int> rows;
        for (int row = 0; row < list->topLevelItemCount(); ++row)
            if (list->topLevelItem(row)->isSelected()) rows.push_back(row);
        return rows;
    };
    EXPECT_EQ(selected(), (std::vector<int>{1, 3}));
    EXPECT_TRUE(form.events.empty());
    QTest::mouseClick(list->viewport(), Qt::LeftButton, Qt::ControlModifier,
                      list->visualItemRect(list->topLevelItem(0)).center());
    ASSERT_FALSE(form.events.empty());
    EXPECT_EQ(form.events.back().second.rank, 0);
    EXPECT_EQ(form.events.back().second.ranks, (std::vector<int>{0, 1, 3}));
    form.model.Change();
    QCoreApplication::processEvents();
    EXPECT_EQ(selected(), (std::vector<int>{0, 1, 3}));
}

// The table and the drawing take the room the dialog gains; the buttons stay at its foot.
TEST_F(OnDemandDialog, TheTableAndTheDrawingTakeTheRoom) {
    ASSERT_TRUE(table && view);
    const QSize tableBefore = table->size(), viewBefore = view->size();
    dialog.resize(1100, 640);
    QCoreApplication::processEvents();
    EXPECT_GT(table->height(), tableBefore.height() + 150);
    EXPECT_GT(view->height(), viewBefore.height() + 150);
    EXPECT_GT(table->width() + view->width(), tableBefore.width() + viewBefore.width() + 150);

    form.selection = {3, 4};
    form.current = 4;
    form.elements = {kElementStation};
    form.model.Change();
    QCoreApplication::processEvents();
    dialog.resize(900, 420);
    QCoreApplication::processEvents();
    const QString folder = QT_TESTCASE_BUILDDIR "/../captures";
    QDir().mkpath(folder);
    EXPECT_TRUE(pyr::bureau::SaveCapture(dialog, folder + "/lignes-et-dessin.png"));
}

} // namespace
