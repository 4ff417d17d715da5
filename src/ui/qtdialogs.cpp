#include "ui/qtdialogs.h"

#include <QApplication>
#include <QFileDialog>
#include <QFileInfo>
#include <QGridLayout>
#include <QInputDialog>
#include <QMainWindow>
#include <QMessageBox>
#include <QPointer>
#include <QPushButton>
#include <QSpacerItem>
#include <QWindow>

#include <utility>

#include "settings/captions.h"
#include "ui/text.h"

namespace kdx {

namespace {

QMessageBox::Icon boxIcon(Dialogs::Icon icon) {
    switch (icon) {
        case Dialogs::Icon::Information:
            return QMessageBox::Information;
        case Dialogs::Icon::Exclamation:
            return QMessageBox::Warning;
        case Dialogs::Icon::Critical:
            return QMessageBox::Critical;
        case Dialogs::Icon::None:
            break;
    }
    return QMessageBox::NoIcon;
}

/// A window without a title is given the program's name by the toolkit.
void leaveTitleEmpty(QMessageBox& box) {
    box.winId();  // makes the window whose title is meant
    box.windowHandle()->setTitle(QStringLiteral(" "));
}

QWidget* mainWindow() {
    for (QWidget* window : QApplication::topLevelWidgets()) {
        if (window->isVisible() && qobject_cast<QMainWindow*>(window) != nullptr) return window;
    }
    return nullptr;
}

/// The window that asks: an editor, which is modal; else the one that is used. While a box that just closed still
/// counts as active there is none: then it is the one that asked before, a view that goes on asking.
QWidget* asker() {
    static QPointer<QWidget> before;
    if (QWidget* const editor = QApplication::activeModalWidget()) return editor;
    if (QWidget* const active = QApplication::activeWindow(); active != nullptr && active->isVisible()) {
        before = active;
    } else if (before == nullptr || !before->isVisible()) {
        before = mainWindow();
    }
    return before;
}

/// Wide enough for the title and a sentence a line.
void widen(QMessageBox& box) {
    auto* grid = qobject_cast<QGridLayout*>(box.layout());
    if (grid == nullptr) return;
    const int width = 56 * box.fontMetrics().averageCharWidth();
    grid->addItem(new QSpacerItem(width, 0), grid->rowCount(), 0, 1, grid->columnCount());
}

void nameParts(QFileDialog& box, const Captions& captions) {
    box.setLabelText(QFileDialog::LookIn, toText(captions.own(1070, "Ordner:")));
    box.setLabelText(QFileDialog::FileName, toText(captions.own(1071, "&Datei:")));
    box.setLabelText(QFileDialog::FileType, toText(captions.own(1072, "Art:")));
}

bool isClicked(const QMessageBox& box, const QAbstractButton* button) {
    return box.clickedButton() == button;
}

}  // namespace

QtDialogs::QtDialogs(const Captions& captions, std::function<bool()> ending)
    : m_captions(captions), m_ending(std::move(ending)) {}

void QtDialogs::message(Icon icon, const QString& title, const QString& text, const QString& details) {
    if (m_ending()) return;
    QMessageBox box(boxIcon(icon), title, text, QMessageBox::NoButton, asker());
    box.setInformativeText(details);
    box.addButton(toText(m_captions.own(317, "OK")), QMessageBox::AcceptRole);
    widen(box);
    box.exec();
}

void QtDialogs::about(const QString& text, const QString& madeOf, const QString& details) {
    if (m_ending()) return;
    QMessageBox box(QMessageBox::Warning, {}, text, QMessageBox::NoButton, asker());
    box.setInformativeText(madeOf);
    box.setDetailedText(details);
    // The only button so far; the toolkit calls it anew at every click.
    for (QAbstractButton* button : box.buttons()) {
        const auto name = [this, button] { button->setText(toText(m_captions.own(947, "&Einzelheiten"))); };
        name();
        QObject::connect(button, &QAbstractButton::clicked, button, name, Qt::QueuedConnection);
    }
    box.addButton(toText(m_captions.own(317, "OK")), QMessageBox::AcceptRole);
    leaveTitleEmpty(box);
    box.exec();
}

bool QtDialogs::messageOrStop(const QString& title, const QString& text, const QString& details,
                              const QString& stopText, Icon icon) {
    if (m_ending()) return true;
    QMessageBox box(boxIcon(icon), title, text, QMessageBox::NoButton, asker());
    box.setInformativeText(details);
    QPushButton* ok = box.addButton(toText(m_captions.own(317, "OK")), QMessageBox::AcceptRole);
    box.setDefaultButton(ok);
    box.setEscapeButton(ok);
    const QPushButton* stop = box.addButton(
        stopText.isEmpty() ? toText(m_captions.own(323, "&Rest abbrechen")) : stopText, QMessageBox::DestructiveRole);
    widen(box);
    box.exec();
    return m_ending() || isClicked(box, stop);
}

bool QtDialogs::confirm(const QString& title, const QString& text) {
    return isConfirmed(title, text, true);
}

bool QtDialogs::confirmLoss(const QString& title, const QString& text) {
    return isConfirmed(title, text, false);
}

bool QtDialogs::isConfirmed(const QString& title, const QString& text, bool yesByReturn) {
    if (m_ending()) return false;
    QMessageBox box(QMessageBox::Question, title, text, QMessageBox::NoButton, asker());
    QPushButton* yes = box.addButton(toText(m_captions.own(315, "&Ja")), QMessageBox::YesRole);
    QPushButton* no = box.addButton(toText(m_captions.own(316, "&Nein")), QMessageBox::NoRole);
    box.setEscapeButton(no);
    box.setDefaultButton(yesByReturn ? yes : no);
    box.exec();
    return isClicked(box, yes);
}

QString QtDialogs::input(const QString& prompt, const QString& title, const QString& preset) {
    if (m_ending()) return {};
    QInputDialog box(asker());
    box.setWindowTitle(title);
    box.setLabelText(prompt);
    box.setTextValue(preset);
    box.setOkButtonText(toText(m_captions.own(317, "OK")));
    box.setCancelButtonText(toText(m_captions.own(318, "Abbrechen")));
    return box.exec() == QDialog::Accepted ? withoutControls(box.textValue()) : QString();
}

QString QtDialogs::fileToSave(const QString& title, const QString& preset, const QString& kind) {
    if (m_ending()) return {};
    QFileDialog box(asker(), title, {}, kind);
    box.setAcceptMode(QFileDialog::AcceptSave);
    nameParts(box, m_captions);
    box.setDefaultSuffix(QFileInfo(preset).suffix());
    box.setOption(QFileDialog::DontConfirmOverwrite);  // asked below, in the language of the window
    box.setLabelText(QFileDialog::Accept, toText(m_captions.own(789, "&Sichern")));
    box.setLabelText(QFileDialog::Reject, toText(m_captions.own(318, "Abbrechen")));
    box.selectFile(preset);
    while (box.exec() == QDialog::Accepted) {
        QString file = box.selectedFiles().value(0);
        const QString question = toText(m_captions.own(898, "%1 überschreiben?")).arg(QFileInfo(file).fileName());
        if (!QFileInfo::exists(file) || confirmLoss(title, question)) return file;
    }
    return {};
}

QString QtDialogs::fileToOpen(const QString& title, const QString& kind, const QString& folder) {
    if (m_ending()) return {};
    QFileDialog box(asker(), title, folder, kind);
    box.setFileMode(QFileDialog::ExistingFile);
    nameParts(box, m_captions);
    box.setLabelText(QFileDialog::Accept, toText(m_captions.own(317, "OK")));
    box.setLabelText(QFileDialog::Reject, toText(m_captions.own(318, "Abbrechen")));
    return box.exec() == QDialog::Accepted ? box.selectedFiles().value(0) : QString();
}

}  // namespace kdx
