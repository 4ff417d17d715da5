#pragma once

#include <QKeySequence>

class QWidget;

namespace kdx::test {

/// Presses and releases a key in the window as the desktop does: the window is the active one, and whatever listens to
/// the key hears it by way of the shortcuts, none where two want it or the window of one is not in use.
void pressKey(QWidget& window, const QKeySequence& keys);

}  // namespace kdx::test
