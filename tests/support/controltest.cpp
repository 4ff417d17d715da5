#include "support/controltest.h"

namespace kdx::test {

void ControlTest::select(const char* name, int index) {
    auto* combo = find<QComboBox>(name);
    combo->setCurrentIndex(index);
    emit combo->activated(index);
}

void ControlTest::press(const char* name, Qt::Key key) {
    for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease}) {
        QKeyEvent event(type, key, Qt::NoModifier);
        QApplication::sendEvent(find(name), &event);
    }
}

bool ControlTest::tick(const char* name) {
    auto* timer = find<QTimer>(name);
    if (!timer->isActive()) return false;
    QTimerEvent event(timer->timerId());
    QApplication::sendEvent(timer, &event);
    return true;
}

std::string ControlTest::text(const char* name) {
    if (auto* label = root().findChild<QLabel*>(QString::fromLatin1(name))) return label->text().toStdString();
    if (auto* box = root().findChild<QLineEdit*>(QString::fromLatin1(name))) return box->text().toStdString();
    if (auto* combo = root().findChild<QComboBox*>(QString::fromLatin1(name))) {
        return combo->currentText().toStdString();
    }
    return find<QAbstractButton>(name)->text().toStdString();
}

bool ControlTest::enabled(const char* name) {
    auto* control = find(name);
    return control->isEnabledTo(control->parentWidget());
}

}  // namespace kdx::test
