#include "window/tour.h"

#include <QCoreApplication>
#include <QDir>
#include <QPixmap>
#include <QPushButton>
#include <QTabWidget>

#include "coder/readback.h"
#include "window/hmenue.h"
#include "ui/text.h"

namespace kdx {

namespace {

/// Control characters and trailing blanks of an answer, so that a line stays a line.
std::string printable(std::string text) {
    text.erase(text.find_last_not_of(" \n\r") + 1);
    for (char& c : text) {
        if (static_cast<unsigned char>(c) < 0x20) c = '.';
    }
    return toText(text).toStdString();
}

}  // namespace

TourDialogs::TourDialogs(std::function<void(const std::string&)> print) : m_print(std::move(print)) {}

void TourDialogs::message(Icon /*icon*/, const QString& title, const QString& text, const QString& /*details*/) {
    note(title, text);
}

bool TourDialogs::messageOrStop(const QString& title, const QString& text) {
    note(title, text);
    return true;
}

bool TourDialogs::confirm(const QString& title, const QString& text) {
    note(title, text);
    return false;
}

QString TourDialogs::input(const QString& prompt, const QString& title, const QString& /*preset*/) {
    note(title, prompt);
    return {};
}

void TourDialogs::note(const QString& title, const QString& text) {
    ++m_count;
    m_print("!! " + title.toStdString() + ": " + text.simplified().toStdString());
}

int makeTour(HMenue& window, const TourDialogs& dialogs, const QString& folder,
             const std::function<void(const std::string&)>& print) {
    int failures = 0;
    int answers = 0;
    const auto watch = QObject::connect(&window, &HMenue::trafficPassed, [&](const Traffic& traffic) {
        if (traffic.kind == Traffic::Kind::Logged) return;
        const bool read = traffic.kind == Traffic::Kind::Read;
        if (read) ++answers;
        if (traffic.status < 0) ++failures;
        print((read ? "<- " : "-> ") + printable(traffic.text) +
              (traffic.status < 0 ? "  [" + std::to_string(traffic.status) + "]" : ""));
    });
    window.show();
    window.INIT_Taste_Click();

    auto* pages = window.findChild<QTabWidget*>(QStringLiteral("SSTab1"));
    if (!QDir().mkpath(folder)) ++failures;
    int pictures = 0;
    for (int page = 0; page < pages->count(); ++page) {
        pages->setCurrentIndex(page);
        QCoreApplication::processEvents();
        const QString file = QDir(folder).filePath(QStringLiteral("page_%1.png").arg(page));
        if (window.grab().save(file)) {
            ++pictures;
        } else {
            ++failures;
            print("!! cannot save " + file.toStdString());
        }
        for (const ReadBack& readBack : readBacks()) {
            auto* button = pages->widget(page)->findChild<QPushButton*>(QString::fromLatin1(readBack.button));
            if (button != nullptr) button->click();
        }
    }
    QObject::disconnect(watch);
    if (answers == 0) ++failures;
    failures += dialogs.count();
    print(std::to_string(pictures) + " pictures, " + std::to_string(answers) + " answers, " + std::to_string(failures) +
          " failures");
    return failures == 0 ? 0 : 1;
}

}  // namespace kdx
