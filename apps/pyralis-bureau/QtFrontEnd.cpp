#include "QtFrontEnd.h"

#include "Capture.h"
#include "FormDialog.h"
#include "ListingViewer.h"
#include "TextWindow.h"
#include "ui/Form.h"

#include <QApplication>
#include <QFileDialog>
#include <QFileInfo>
#include <QMessageBox>
#include <QPushButton>
#include <QTabWidget>
#include <cstdio>
#include <memory>

namespace pyr::bureau {

namespace {

QString Text(std::string_view text) {
    return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
}

QMessageBox::Icon BoxIcon(int icon) {
    switch (icon) {
    case ui::kIconError:
        return QMessageBox::Critical;
    case ui::kIconQuestion:
        return QMessageBox::Question;
    case ui::kIconWarning:
        return QMessageBox::Warning;
    case ui::kIconInformation:
        return QMessageBox::Information;
    default:
        return QMessageBox::NoIcon;
    }
}

const char* AnswerWord(ui::Answer answer) {
    switch (answer) {
    case ui::Answer::Yes:
        return "Oui";
    case ui::Answer::No:
        return "Non";
    case ui::Answer::Cancel:
        return "Annuler";
    }
    return "";
}

} // namespace

QString QtFilter(std::string_view filter) {
    // "Label (*.a)|*.a|Other (*.b)|*.b||": label and pattern by pairs, ended by an empty pair.
    const QStringList parts = Text(filter).split('|');
    QStringList filters;
    for (qsizetype rank = 0; rank + 1 < parts.size(); rank += 2) {
        const QString label = parts[rank].trimmed();
        const QString pattern = parts[rank + 1].trimmed().replace(';', ' ');
        if (label.isEmpty() && pattern.isEmpty()) break;
        if (label.contains('(') || pattern.isEmpty())
            filters << label;
        else
            filters << QString("%1 (%2)").arg(label, pattern);
    }
    return filters.join(";;");
}

void QtFrontEnd::MessageBox(std::string_view text, std::string_view caption, int icon) {
    if (Unattended()) {
        std::fprintf(stderr, "%.*s : %.*s\n", static_cast<int>(caption.size()), caption.data(),
                     static_cast<int>(text.size()), text.data());
        return;
    }
    QMessageBox box(BoxIcon(icon), Text(caption), Text(text), QMessageBox::NoButton, m_parent);
    box.addButton("OK", QMessageBox::AcceptRole);
    box.exec();
}

ui::Answer QtFrontEnd::Ask(std::string_view text, std::string_view caption, ui::Buttons buttons,
                           ui::Answer byDefault, int icon) {
    if (Unattended()) {
        std::fprintf(stderr, "%.*s : %.*s [%s]\n", static_cast<int>(caption.size()), caption.data(),
                     static_cast<int>(text.size()), text.data(), AnswerWord(byDefault));
        return byDefault;
    }
    QMessageBox box(BoxIcon(icon), Text(caption), Text(text), QMessageBox::NoButton, m_parent);
    QPushButton* yes = box.addButton("&Oui", QMessageBox::YesRole);
    QPushButton* no = box.addButton("&Non", QMessageBox::NoRole);
    QPushButton* cancel =
        buttons == ui::Buttons::YesNoCancel ? box.addButton("Annuler", QMessageBox::RejectRole) : nullptr;
    yes->setObjectName("oui");
    no->setObjectName("non");
    if (cancel) cancel->setObjectName("annuler");
    box.setDefaultButton(byDefault == ui::Answer::Yes             ? yes
                         : byDefault == ui::Answer::No || !cancel ? no
                                                                  : cancel);
    // Escape cancels the question, or says no when it offers only yes and no.
    box.setEscapeButton(cancel ? cancel : no);
    box.exec();
    if (box.clickedButton() == yes) return ui::Answer::Yes;
    if (box.clickedButton() == no) return ui::Answer::No;
    return cancel ? ui::Answer::Cancel : ui::Answer::No;
}

std::optional<std::string> QtFrontEnd::ChooseFile(const ui::FileChoice& choice) {
    if (Unattended()) {
        if (choice.startPath.empty() || (!choice.save && !QFileInfo(Text(choice.startPath)).isFile()))
            return std::nullopt;
        return choice.startPath;
    }
    QFileDialog dialog(m_parent, Text(choice.title));
    dialog.setAcceptMode(choice.save ? QFileDialog::AcceptSave : QFileDialog::AcceptOpen);
    dialog.setFileMode(choice.save ? QFileDialog::AnyFile : QFileDialog::ExistingFile);
    dialog.setNameFilter(QtFilter(choice.filter));
    dialog.setDefaultSuffix(Text(choice.defaultExtension));
    // The file offered: its folder opens with its name ready to be taken.
    const QFileInfo start(Text(choice.startPath));
    if (!choice.startPath.empty()) {
        if (start.isDir()) {
            dialog.setDirectory(start.absoluteFilePath());
        } else {
            dialog.setDirectory(start.absolutePath());
            dialog.selectFile(start.fileName());
        }
    }
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty()) return std::nullopt;
    return dialog.selectedFiles().front().toStdString();
}

void QtFrontEnd::TextLine(std::string_view line) {
    if (m_textWindow)
        m_textWindow->AddLine(Text(line));
    else
        std::fprintf(stdout, "%.*s\n", static_cast<int>(line.size()), line.data());
}

ui::DialogResult QtFrontEnd::DoModal(ui::Dialog& dialog) {
    const bool capturing = !m_capture.empty() && !m_captured;
    // The GéoBase to capture goes to the command's dialog, not to the dialogs it opens.
    if (capturing && !m_geoBase.empty() && !m_geoBaseGiven) {
        dialog.SetGeoBase(m_geoBase);
        m_geoBaseGiven = true;
    }
    std::unique_ptr<ui::Form> form = dialog.MakeForm();
    // A dialog that has no window yet runs as a command line without options would run it.
    if (!form) return dialog.Run(*this);
    if (!form->Open(*this)) return form->Ended().value_or(ui::DialogResult::Failed);
    FormDialog window(*form, *this, m_parent);
    if (capturing) return Capture(window);
    // Nobody is there to close a dialog: it is not shown.
    if (Unattended()) return ui::DialogResult::Cancel;
    window.exec();
    return window.Result();
}

ui::DialogResult QtFrontEnd::Capture(FormDialog& window) {
    window.adjustSize();
    window.show();
    QApplication::processEvents();
    // The dialog that a button of this one opens is the one drawn ("Paramètres...", "Réduction").
    if (!m_button.empty() && !m_buttonPressed) {
        m_buttonPressed = true;
        auto* button = window.findChild<QPushButton*>(Text(m_button));
        if (!button || !button->isEnabled())
            m_captureFailure = "La boîte de dialogue n'a pas de bouton « " + m_button + " » à presser.";
        else
            button->click();
        window.hide();
        return ui::DialogResult::Cancel;
    }
    m_captured = true;
    // A sheet is drawn page after page: "options.png", then "options-2.png" ...
    auto* pages = window.findChild<QTabWidget*>("pages");
    const int count = pages ? pages->count() : 1;
    const QString base =
        Text(m_capture).chopped(Text(m_capture).endsWith(".png", Qt::CaseInsensitive) ? 4 : 0);
    for (int page = 0; page < count; ++page) {
        if (pages) pages->setCurrentIndex(page);
        window.Refresh();
        QApplication::processEvents();
        const QString path = page == 0 ? Text(m_capture) : QString("%1-%2.png").arg(base).arg(page + 1);
        if (!SaveCapture(window, path))
            m_captureFailure = "L'image <" + path.toStdString() + "> n'a pas pu être écrite.";
    }
    window.hide();
    return ui::DialogResult::Cancel;
}

void QtFrontEnd::ShowFile(const std::string& path) {
    if (Unattended()) return;
    ShowInViewer(QString::fromStdString(path), m_parent);
}

} // namespace pyr::bureau
