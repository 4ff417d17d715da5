#include "ui/plaintext.h"

#include <QLabel>

namespace kdx {

void keepTextPlain(QObject& control) {
    if (auto* label = qobject_cast<QLabel*>(&control)) {
        label->setTextFormat(Qt::PlainText);  // the tool tip is one too
    }
}

}  // namespace kdx
