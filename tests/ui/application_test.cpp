#include "ui/application.h"

#include <gtest/gtest.h>

#include <QFontInfo>
#include <QTimer>

#include <stdexcept>

namespace kdx {
namespace {

TEST(ApplicationTest, AnExceptionThatLeavesAHandlerIsToldAndTheProgramGoesOn) {
    auto& application = dynamic_cast<Application&>(*QCoreApplication::instance());
    QString doing;
    QString error;
    application.onFailure([&](const QString& what, const QString& why) {
        doing = what;
        error = why;
    });
    QTimer timer;
    timer.setObjectName(QStringLiteral("PS_Timer"));
    QObject::connect(&timer, &QTimer::timeout, [] { throw std::runtime_error("page 9 of 0 to 8"); });
    timer.start(10000);
    QTimerEvent tick(timer.timerId());
    QCoreApplication::sendEvent(&timer, &tick);
    EXPECT_EQ(doing, QStringLiteral("PS_Timer"));
    EXPECT_EQ(error, QStringLiteral("page 9 of 0 to 8"));
    application.onFailure(nullptr);
}

TEST(ApplicationTest, SpeaksInArialOrItsMetricTwin) {
    EXPECT_TRUE(QApplication::font().families().startsWith(QStringLiteral("Arial")));
    const QString used = QFontInfo(QApplication::font()).family();
    EXPECT_TRUE(used == QStringLiteral("Arial") || used == QStringLiteral("Liberation Sans")) << used.toStdString();
}

}  // namespace
}  // namespace kdx
