// A dialog built from a form: the widgets follow the states, the person's actions reach the form, and
// the form decides when it closes.
#include "FormDialog.h"
#include "ui/ScriptedFrontEnd.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QTabWidget>
#include <QTest>
#include <QTreeWidget>
#include <gtest/gtest.h>

namespace {

using namespace pyr::ui;

// A model with a list of points, a choice, a switch and a typed name; the form below shows it.
class PointsModel : public DialogModel {
public:
    std::vector<std::string> points{"100", "101", "102"};
    int chosen = -1;
    bool plani = true;
    std::string typed;
    int saved = 0;

    void Change() { Notify(1); }
};

enum : int { kLabel = 10, kCombo, kList, kSwitch, kName, kResult, kSave, kTable, kPage1, kPage2, kOnPage };

class PointsForm : public Form {
public:
    explicit PointsForm(PointsModel& model) : m_model(model) {}
    DialogModel& Model() override { return m_model; }
    std::string Caption() override { return "Calcul de points"; }
    std::vector<Control> Controls() const override {
        using enum ControlKind;
        // clang-format off
        return {
            {.id = kLabel, .kind = Label, .text = "&Point :", .buddy = kCombo},
            {.id = kCombo, .kind = EditCombo, .name = "point", .column = 1},
            {.id = kList, .kind = List, .name = "liste", .row = 1, .columnSpan = 2},
            {.id = kSwitch, .kind = Check, .name = "plani", .text = "&Planimétrie", .row = 2},
            {.id = kName, .kind = Edit, .name = "nom", .row = 3, .column = 1},
            {.id = kResult, .kind = Field, .name = "resultat", .row = 4, .column = 1},
            {.id = kTable, .kind = List, .name = "table", .row = 5, .columns = {"Point", "X"}},
            {.id = kPage1, .kind = Page, .name = "page1", .text = "Première"},
            {.id = kPage2, .kind = Page, .name = "page2", .text = "Seconde"},
            {.id = kOnPage, .kind = Check, .name = "surPage", .text = "&Sur la page", .parent = kPage2},
            {.id = kSave, .kind = Button, .name = "enregistrer", .text = "&Enregistrer", .parent = kButtonRow,
             .isDefault = true},
            {.id = kIdCancel, .kind = Button, .name = "annuler", .text = "Annuler", .parent = kButtonRow},
        };
        // clang-format on
    }
    bool Open(FrontEnd&) override { return true; }
    ControlState State(int id) const override {
        ControlState state;
        switch (id) {
        case kCombo:
        case kList:
            state.items = m_model.points;
            state.tips = {"premier", "deuxième", "troisième"};
            state.current = m_model.chosen;
            break;
        case kSwitch:
            state.checked = m_model.plani;
            break;
        case kName:
            state.text = m_model.typed;
            break;
        case kResult:
            state.text = m_model.chosen < 0 ? "" : "X = " + m_model.points[m_model.chosen];
            break;
        case kTable:
            state.items = {"100\t1000.000", "101\t1010.000"};
            break;
        case kSave:
            state.enabled = m_model.chosen >= 0;
            break;
        }
        return state;
    }
    void Act(FrontEnd&, int id, const Event& event) override {
        events.push_back(event);
        if (id == kCombo || id == kList) {
            if (event.kind == EventKind::Select) m_model.chosen = event.rank;
            if (event.kind == EventKind::Text) {
                m_model.points.push_back(event.text);
                m_model.chosen = static_cast<int>(m_model.points.size()) - 1;
            }
        }
        if (id == kSwitch) m_model.plani = event.on;
        if (id == kName) m_model.typed = event.text;
        if (id == kSave) {
            ++m_model.saved;
            End(DialogResult::Ok);
        }
        if (id == kIdCancel && cancelCloses) End(DialogResult::Cancel);
    }

    std::vector<Event> events;
    bool cancelCloses = true;

private:
    PointsModel& m_model;
};

template <class Widget>
Widget* Find(QWidget& dialog, const char* name) {
    auto* widget = dialog.findChild<Widget*>(name);
    EXPECT_NE(widget, nullptr) << name;
    return widget;
}

struct FormDialogTest : testing::Test {
    PointsModel model;
    PointsForm form{model};
    ScriptedFrontEnd frontEnd;
};

TEST_F(FormDialogTest, WidgetsShowTheStatesAndSendTheActions) {
    pyr::bureau::FormDialog dialog(form, frontEnd);
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&dialog));
    EXPECT_EQ(dialog.windowTitle(), "Calcul de points");
    auto* combo = Find<QComboBox>(dialog, "point");
    auto* list = Find<QListWidget>(dialog, "liste");
    auto* save = Find<QPushButton>(dialog, "enregistrer");
    ASSERT_TRUE(combo && list && save);
    EXPECT_EQ(combo->count(), 3);
    EXPECT_EQ(list->item(1)->toolTip(), "deuxième");
    EXPECT_FALSE(save->isEnabled());

    // A line chosen in the list reaches the model, and every control shows the new state.
    list->setCurrentRow(2);
    EXPECT_EQ(model.chosen, 2);
    EXPECT_EQ(combo->currentIndex(), 2);
    EXPECT_EQ(Find<QLineEdit>(dialog, "resultat")->text(), "X = 102");
    EXPECT_TRUE(save->isEnabled());

    // The check box and the edit send their values; the edit only once committed.
    Find<QCheckBox>(dialog, "plani")->click();
    EXPECT_FALSE(model.plani);
    auto* name = Find<QLineEdit>(dialog, "nom");
    name->setFocus();
    QTest::keyClicks(name, "P7");
    EXPECT_EQ(model.typed, "");
    QTest::keyClick(name, Qt::Key_Tab);
    EXPECT_EQ(model.typed, "P7");

    auto* table = Find<QTreeWidget>(dialog, "table");
    ASSERT_EQ(table->topLevelItemCount(), 2);
    EXPECT_EQ(table->topLevelItem(1)->text(1), "1010.000");
    EXPECT_EQ(Find<QTabWidget>(dialog, "pages")->count(), 2);
    EXPECT_NE(Find<QCheckBox>(dialog, "surPage"), nullptr);

    // A name typed in the combo is sent by Enter, which does not press the default button, now enabled.
    combo->setFocus();
    combo->lineEdit()->selectAll();
    QTest::keyClicks(combo->lineEdit(), "A9");
    QTest::keyClick(combo->lineEdit(), Qt::Key_Return);
    EXPECT_EQ(model.points.back(), "A9");
    EXPECT_EQ(model.saved, 0);
    EXPECT_TRUE(dialog.isVisible());

    // A change notice of the model is shown.
    model.points = {"200"};
    model.chosen = 0;
    model.Change();
    QCoreApplication::processEvents();
    EXPECT_EQ(combo->count(), 1);
    EXPECT_EQ(Find<QLineEdit>(dialog, "resultat")->text(), "X = 200");
}

TEST_F(FormDialogTest, TheFormDecidesWhenTheDialogCloses) {
    model.chosen = 1;
    {
        pyr::bureau::FormDialog dialog(form, frontEnd);
        dialog.show();
        // Enter presses the default button, which ends the dialog.
        QTest::keyClick(&dialog, Qt::Key_Return);
        EXPECT_EQ(model.saved, 1);
        EXPECT_EQ(dialog.Result(), DialogResult::Ok);
        EXPECT_FALSE(dialog.isVisible());
    }
    {
        // Escape is the form's Cancel: a form that does not end (a question answered "Annuler") keeps
        // the dialog open.
        PointsForm form{model};
        form.cancelCloses = false;
        pyr::bureau::FormDialog dialog(form, frontEnd);
        dialog.show();
        QTest::keyClick(&dialog, Qt::Key_Escape);
        EXPECT_TRUE(dialog.isVisible());
        form.cancelCloses = true;
        QTest::keyClick(&dialog, Qt::Key_Escape);
        EXPECT_FALSE(dialog.isVisible());
        EXPECT_EQ(dialog.Result(), DialogResult::Cancel);
    }
}

} // namespace
