// The GéoBase editor's window as a person uses it on the demo job: a line of the table chosen, the drawing
// showing it, a field changed on its page and the change undone, a search, and the window closed.
#include "Capture.h"
#include "FormDialog.h"
#include "GeoView.h"
#include "TestSupport.h"
#include "editor/GeoEditorForm.h"
#include "ui/ScriptedFrontEnd.h"

#include <QDir>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QTest>
#include <filesystem>
#include <gtest/gtest.h>

namespace pyr::test {
namespace {

constexpr int kStationS1 = 9; // the element "000010  Station  S1": the first set-up on S1

class EditorWindow : public ::testing::Test {
protected:
    EditorWindow() {
        std::filesystem::copy_file(PYR_SOURCE_DIR "/data/chantier-demo.geo", dir / "chantier.geo");
        editor.SetInputs({dir / "chantier.geo", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        editor.SetGeoBase(dir / "chantier.geo");
        form = editor.MakeForm();
        EXPECT_TRUE(form->Open(frontEnd));
        dialog = std::make_unique<bureau::FormDialog>(*form, frontEnd);
        dialog->resize(1100, 860);
        dialog->show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(dialog.get()));
        table = dialog->findChild<QTableView*>("elements0");
        view = dialog->findChild<bureau::GeoView*>("dessin");
        EXPECT_TRUE(table && view);
    }
    template <class Widget>
    Widget& Find(const char* name) {
        auto* widget = dialog->findChild<Widget*>(name);
        if (!widget) throw std::runtime_error(std::string("pas de contrôle ") + name);
        return *widget;
    }
    void Click(const char* name) {
        auto& button = Find<QPushButton>(name);
        EXPECT_TRUE(button.isEnabled()) << name;
        QTest::mouseClick(&button, Qt::LeftButton);
    }
    void Type(const char* name, const QString& text) {
        auto& edit = Find<QLineEdit>(name);
        edit.selectAll();
        QTest::keyClicks(&edit, text);
        QTest::keyClick(&edit, Qt::Key_Return);
    }
    void ChooseLine(int rank) {
        table->scrollTo(table->model()->index(rank, 0));
        QTest::mouseClick(table->viewport(), Qt::LeftButton, {},
                          table->visualRect(table->model()->index(rank, 0)).center());
        QApplication::processEvents();
    }
    QString Cell(int rank, int column) const { return table->model()->index(rank, column).data().toString(); }

    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CGeoEditor editor;
    std::unique_ptr<ui::Form> form;
    std::unique_ptr<bureau::FormDialog> dialog; // closed before its form and its model
    QTableView* table = nullptr;
    bureau::GeoView* view = nullptr;
};

TEST_F(EditorWindow, ALineChosenIsEditedOnItsPageShownInTheDrawingAndUndone) {
    EXPECT_EQ(table->model()->rowCount(), editor.Carnet().GetSize());
    ChooseLine(kStationS1);
    ASSERT_EQ(editor.Document().Selection(), std::vector<int>{kStationS1});
    // The drawing rings the station chosen in the table.
    EXPECT_EQ(view->SelectedElements(), std::vector<int>{kStationS1});
    EXPECT_EQ(view->SelectedStations().size(), 1u);
    EXPECT_EQ(Find<QLineEdit>("champ0").text(), "S1");
    EXPECT_EQ(Find<QLineEdit>("champ1").text(), "1.562");

    // Its instrument height changed on the page, then the change undone.
    Type("champ1", "1,605");
    EXPECT_EQ(Cell(kStationS1, 2), "S1  1.605  -999999");
    EXPECT_TRUE(Find<QPushButton>("enregistrer").isEnabled());
    Click("annuler");
    EXPECT_EQ(Cell(kStationS1, 2), "S1  1.562  -999999");
    EXPECT_TRUE(Find<QPushButton>("retablir").isEnabled());
    Click("retablir");
    ChooseLine(kStationS1);
    QDir().mkpath(QT_TESTCASE_BUILDDIR "/../captures");
    EXPECT_TRUE(
        bureau::SaveCapture(*dialog, QT_TESTCASE_BUILDDIR "/../captures/GeoEdit-station-choisie.png"));

    // A search selects every element of A1, in the table and in the drawing.
    Type("chercherMatricules", "A1");
    Click("chercher");
    EXPECT_EQ(table->selectionModel()->selectedRows().size(), 3);
    EXPECT_EQ(view->SelectedPoints().size(), 1u);

    // Closed: the modified GéoBase is saved when the person says so.
    frontEnd.answers = {ui::Answer::Yes};
    Click("fermer");
    EXPECT_EQ(dialog->Result(), ui::DialogResult::Ok);
    EXPECT_NE(ReadBytes(dir / "chantier.geo").find("1001\tS1\t1.605"), std::string::npos);
}

} // namespace
} // namespace pyr::test
