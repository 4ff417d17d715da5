#include "ui/application.h"

#include <gtest/gtest.h>

#include <QFontInfo>
#include <QMessageBox>
#include <QTimer>

#include <stdexcept>

namespace kdx {
namespace {

TEST(LetterSizeTest, IsTheDesktopsWhereThatIsLargerThanUsual) {
    EXPECT_EQ(letterSize(9), 8.25);
    EXPECT_EQ(letterSize(-1), 8.25);  // a font in pixels
    EXPECT_EQ(letterSize(10), 10);
    EXPECT_EQ(letterSize(12), 12);
}

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

TEST(ApplicationTest, WhatNoControlStartedIsGuardedTheSameWay) {
    auto& application = dynamic_cast<Application&>(*QCoreApplication::instance());
    QStringList told;
    application.onFailure([&](const QString& what, const QString& why) { told << what << why; });
    EXPECT_TRUE(application.guarded(QStringLiteral("HMenue"), [] {}));
    EXPECT_EQ(told, QStringList());
    EXPECT_FALSE(application.guarded(QStringLiteral("HMenue"), [] { throw std::runtime_error("no data"); }));
    EXPECT_FALSE(application.guarded(QStringLiteral("tour"), [] { throw 7; }));
    EXPECT_EQ(told, QStringList({QStringLiteral("HMenue"), QStringLiteral("no data"), QStringLiteral("tour"),
                                 QStringLiteral("?")}));
    application.onFailure(nullptr);
}

class Unpaintable : public QWidget {
protected:
    void paintEvent(QPaintEvent* /*event*/) override { throw std::runtime_error("no picture"); }
};

TEST(ApplicationTest, AFailedPaintingIsWrittenOnceAndOpensNoBox) {
    auto& application = dynamic_cast<Application&>(*QCoreApplication::instance());
    int boxes = 0;
    application.onFailure([&](const QString&, const QString&) { ++boxes; });
    Unpaintable widget;
    widget.setObjectName(QStringLiteral("RDS_OnOff"));
    testing::internal::CaptureStderr();
    widget.show();
    QCoreApplication::processEvents();  // nothing is painted before the window system has shown it
    for (int times = 0; times < 3; ++times) widget.repaint();
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "kdx-rds: RDS_OnOff cannot be painted: no picture\n");
    EXPECT_EQ(boxes, 0);
    application.onFailure(nullptr);
}

TEST(ApplicationTest, EndingClosesTheWindowAndABoxOverIt) {
    auto& application = dynamic_cast<Application&>(*QCoreApplication::instance());
    EXPECT_FALSE(application.isEnding());
    QWidget window;
    QMessageBox box(QMessageBox::Critical, QString(), QStringLiteral("Fehler"), QMessageBox::Ok, &window);
    bool endingInTheBox = false;
    QTimer::singleShot(0, &window, [&] {
        box.exec();
        endingInTheBox = application.isEnding();
    });
    QTimer::singleShot(50, &application, [&] { application.end(); });
    window.show();
    EXPECT_EQ(QApplication::exec(), 0);
    EXPECT_TRUE(endingInTheBox);
    EXPECT_FALSE(window.isVisible());
}

TEST(ApplicationTest, ABoxOfTheStartIsClosedToo) {
    auto& application = dynamic_cast<Application&>(*QCoreApplication::instance());
    QMessageBox box(QMessageBox::Critical, QString(), QStringLiteral("Fehler"), QMessageBox::Ok);
    QTimer::singleShot(50, &application, [&] { application.end(); });
    box.exec();  // before the event loop of the program runs
    EXPECT_TRUE(application.isEnding());
    QTimer::singleShot(0, &application, [] { QApplication::quit(); });
    QApplication::exec();  // takes the end back for the tests after this one
}

TEST(ApplicationTest, ClosingTheLastWindowEndsTheProgram) {
    auto& application = dynamic_cast<Application&>(*QCoreApplication::instance());
    QWidget window;
    QTimer::singleShot(0, &window, [&] { window.close(); });
    window.show();
    QApplication::exec();
    EXPECT_TRUE(application.isEnding());
}

TEST(ApplicationTest, SpeaksInArialOrItsMetricTwin) {
    EXPECT_TRUE(QApplication::font().families().startsWith(QStringLiteral("Arial")));
    const QString used = QFontInfo(QApplication::font()).family();
    EXPECT_TRUE(used == QStringLiteral("Arial") || used == QStringLiteral("Liberation Sans")) << used.toStdString();
}

}  // namespace
}  // namespace kdx
