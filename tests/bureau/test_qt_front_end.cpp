// The Qt face of the seam to a person: message boxes and questions as the system words them, its file
// filters, and the dialogs run from their forms (or as a command line without options when they have
// none).
#include "QtFrontEnd.h"
#include "TextWindow.h"
#include "ui/Dialog.h"
#include "ui/Form.h"

#include <QApplication>
#include <QMessageBox>
#include <QPushButton>
#include <QTimer>
#include <functional>
#include <gtest/gtest.h>

namespace {

using namespace pyr::ui;
using pyr::bureau::QtFrontEnd;

// Runs `look` on the modal box once it is open (the box being modal, the test waits in it).
void OnModalBox(std::function<void(QMessageBox&)> look) {
    QTimer::singleShot(0, [look] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        look(*box);
    });
}

TEST(QtFrontEnd, MessageBoxesAndQuestionsCarryTheCaptionTheIconAndTheDefault) {
    QtFrontEnd frontEnd;
    OnModalBox([](QMessageBox& box) {
        EXPECT_EQ(box.windowTitle(), "PYRALIS");
        EXPECT_EQ(box.text(), "Le fichier de paramétrage indiqué n'existe pas !");
        EXPECT_EQ(box.icon(), QMessageBox::Warning);
        box.buttons().front()->click();
    });
    frontEnd.MessageBox("Le fichier de paramétrage indiqué n'existe pas !", kCaption, kIconWarning);

    // Yes, no and cancel: the default is the button Enter presses, Escape cancels.
    OnModalBox([](QMessageBox& box) {
        EXPECT_EQ(box.icon(), QMessageBox::Question);
        EXPECT_EQ(box.defaultButton()->text(), "&Non");
        EXPECT_EQ(box.buttons().size(), 3);
        box.defaultButton()->click();
    });
    EXPECT_EQ(
        frontEnd.Ask("La GéoBase courante a été modifiée !", kCaption, Buttons::YesNoCancel, Answer::No),
        Answer::No);
    OnModalBox([](QMessageBox& box) { box.reject(); });
    EXPECT_EQ(frontEnd.Ask("Compléter ?", kCaption, Buttons::YesNoCancel, Answer::Yes), Answer::Cancel);
    // With only yes and no, Escape says no.
    OnModalBox([](QMessageBox& box) {
        EXPECT_EQ(box.buttons().size(), 2);
        box.reject();
    });
    EXPECT_EQ(frontEnd.Ask("Remplacer ?", kCaption, Buttons::YesNo, Answer::Yes), Answer::No);
}

TEST(QtFrontEnd, FiltersOfTheSystemBecomeQtFilters) {
    using pyr::bureau::QtFilter;
    EXPECT_EQ(QtFilter("GéoBase PYRALIS (*.geo)|*.geo||"), "GéoBase PYRALIS (*.geo)");
    EXPECT_EQ(QtFilter("Listing d'intersection (*.cin)|*.cin||"), "Listing d'intersection (*.cin)");
    EXPECT_EQ(QtFilter("Carnets Wild|*.gsi;*.gre|Tous|*.*||"), "Carnets Wild (*.gsi *.gre);;Tous (*.*)");
}

// A dialog without a window, whose Run says what it did.
struct PlainDialog : Dialog {
    DialogResult Run(FrontEnd& frontEnd) override {
        frontEnd.TextLine("lancée sans fenêtre");
        return DialogResult::Ok;
    }
};

// A dialog whose window counts its openings.
struct CountingDialog : PlainDialog {
    std::unique_ptr<Form> MakeForm() override;
    int opened = 0;
};

class RefusingForm : public Form {
public:
    explicit RefusingForm(CountingDialog& dialog) : m_dialog(dialog) {}
    DialogModel& Model() override { return m_dialog; }
    std::vector<Control> Controls() const override { return {}; }
    bool Open(FrontEnd&) override {
        ++m_dialog.opened;
        End(DialogResult::Cancel); // the person chose no GéoBase
        return false;
    }
    ControlState State(int) const override { return {}; }
    void Act(FrontEnd&, int, const Event&) override {}

private:
    CountingDialog& m_dialog;
};

std::unique_ptr<Form> CountingDialog::MakeForm() {
    return std::make_unique<RefusingForm>(*this);
}

TEST(QtFrontEnd, ADialogWithoutAWindowRunsAsACommandLineWouldAndAFormThatDoesNotOpenSaysHow) {
    QtFrontEnd frontEnd;
    pyr::bureau::TextWindow text;
    frontEnd.SetTextWindow(&text);
    PlainDialog plain;
    EXPECT_EQ(frontEnd.DoModal(plain), DialogResult::Ok);
    EXPECT_EQ(text.toPlainText(), "lancée sans fenêtre");

    CountingDialog windowed;
    EXPECT_EQ(frontEnd.DoModal(windowed), DialogResult::Cancel);
    EXPECT_EQ(windowed.opened, 1);
}

} // namespace
