#include "ListingViewer.h"

#include <QDesktopServices>
#include <QDialog>
#include <QDialogButtonBox>
#include <QFile>
#include <QFileInfo>
#include <QFontDatabase>
#include <QMessageBox>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QStringDecoder>
#include <QUrl>
#include <QVBoxLayout>

namespace pyr::bureau {

namespace {

// The file's text: UTF-8, or Windows-1252 when it is not valid UTF-8 (a file from a Windows machine).
QString FileText(const QByteArray& bytes) {
    QStringDecoder utf8(QStringDecoder::Utf8);
    QString text = utf8(bytes);
    if (!utf8.hasError()) return text;
    QStringDecoder windows("windows-1252");
    return windows.isValid() ? windows(bytes) : QString::fromLatin1(bytes);
}

} // namespace

void ShowInViewer(const QString& path, QWidget* parent) {
    const QFileInfo info(path);
    if (info.suffix().compare("rtf", Qt::CaseInsensitive) == 0) {
        if (!QDesktopServices::openUrl(QUrl::fromLocalFile(info.absoluteFilePath())))
            QMessageBox::warning(parent, "PYRALIS",
                                 QString("Aucun programme n'est là pour montrer le fichier <%1>.").arg(path));
        return;
    }
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        QMessageBox::warning(
            parent, "PYRALIS",
            QString("Le fichier <%1> n'a pas pu être ouvert :\n%2").arg(path, file.errorString()));
        return;
    }
    auto* window = new QDialog(parent);
    window->setAttribute(Qt::WA_DeleteOnClose);
    window->setObjectName("visionneuse");
    window->setWindowTitle(QString("PYRALIS - %1").arg(info.fileName()));
    auto* layout = new QVBoxLayout(window);
    auto* text = new QPlainTextEdit(window);
    text->setReadOnly(true);
    text->setLineWrapMode(QPlainTextEdit::NoWrap);
    text->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    text->setPlainText(FileText(file.readAll()));
    layout->addWidget(text);
    auto* buttons = new QDialogButtonBox(window);
    buttons->addButton("&Fermer", QDialogButtonBox::RejectRole);
    QObject::connect(buttons, &QDialogButtonBox::rejected, window, &QDialog::close);
    layout->addWidget(buttons);
    window->resize(text->fontMetrics().averageCharWidth() * 110, 600);
    window->show();
}

} // namespace pyr::bureau
