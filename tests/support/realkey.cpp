#include "support/realkey.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QTest>
#include <QWidget>

namespace kdx::test {

void pressKey(QWidget& window, const QKeySequence& keys) {
    window.activateWindow();
    QCoreApplication::processEvents();
    ASSERT_EQ(QApplication::activeWindow(), &window);
    ASSERT_EQ(keys.count(), 1);
    QTest::keyClick(window.windowHandle(), keys[0].key(), keys[0].keyboardModifiers());
}

}  // namespace kdx::test
