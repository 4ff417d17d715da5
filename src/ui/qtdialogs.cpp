#include "ui/qtdialogs.h"

#include <QApplication>
#include <QInputDialog>
#include <QMessageBox>
#include <QPushButton>

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

}  // namespace

QtDialogs::QtDialogs(const Captions& captions) : m_captions(captions) {}

void QtDialogs::message(Icon icon, const QString& title, const QString& text, const QString& details) {
    QMessageBox box(boxIcon(icon), title, text, QMessageBox::NoButton, QApplication::activeWindow());
    box.setInformativeText(details);
    box.addButton(toText(m_captions.own(317, "OK")), QMessageBox::AcceptRole);
    box.exec();
}

bool QtDialogs::messageOrStop(const QString& title, const QString& text) {
    QMessageBox box(QMessageBox::Critical, title, text, QMessageBox::NoButton, QApplication::activeWindow());
    QPushButton* ok = box.addButton(toText(m_captions.own(317, "OK")), QMessageBox::AcceptRole);
    box.setDefaultButton(ok);
    box.setEscapeButton(ok);
    const QPushButton* stop =
        box.addButton(toText(m_captions.own(323, "&Rest abbrechen")), QMessageBox::DestructiveRole);
    box.exec();
    return static_cast<const QAbstractButton*>(box.clickedButton()) == static_cast<const QAbstractButton*>(stop);
}

bool QtDialogs::confirm(const QString& title, const QString& text) {
    QMessageBox box(QMessageBox::Question, title, text, QMessageBox::NoButton, QApplication::activeWindow());
    const QPushButton* yes = box.addButton(toText(m_captions.own(315, "&Ja")), QMessageBox::YesRole);
    box.setEscapeButton(box.addButton(toText(m_captions.own(316, "&Nein")), QMessageBox::NoRole));
    box.exec();
    return static_cast<const QAbstractButton*>(box.clickedButton()) == static_cast<const QAbstractButton*>(yes);
}

QString QtDialogs::input(const QString& prompt, const QString& title, const QString& preset) {
    QInputDialog box(QApplication::activeWindow());
    box.setWindowTitle(title);
    box.setLabelText(prompt);
    box.setTextValue(preset);
    box.setOkButtonText(toText(m_captions.own(317, "OK")));
    box.setCancelButtonText(toText(m_captions.own(318, "Abbrechen")));
    return box.exec() == QDialog::Accepted ? withoutControls(box.textValue()) : QString();
}

}  // namespace kdx
