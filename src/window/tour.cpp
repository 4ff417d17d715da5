#include "window/tour.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QPixmap>
#include <QPushButton>
#include <QTabWidget>

#include "base/printable.h"
#include "coder/readback.h"
#include "link/instrument.h"
#include "ui/text.h"
#include "window/hmenue.h"

namespace kdx {

namespace {

/// Not a link, a pipe or a device: what is behind them is not the tour's to overwrite, and nobody may read the pipe.
bool isPlainOrMissing(const QString& file) {
    const QFileInfo place(file);
    return !place.isSymLink() && (place.isFile() || !place.exists());
}

/// Prints what is written and read while it lives, and counts the answers and what failed.
class TrafficPrinter final : public TrafficWatcher {
public:
    TrafficPrinter(Instrument& instrument, const std::function<void(const std::string&)>& print)
        : m_instrument(instrument), m_print(print) {
        m_instrument.addWatcher(*this);
    }
    ~TrafficPrinter() override { m_instrument.removeWatcher(*this); }
    TrafficPrinter(const TrafficPrinter&) = delete;
    TrafficPrinter& operator=(const TrafficPrinter&) = delete;

    void passed(const Traffic& traffic) override {
        if (traffic.kind == Traffic::Kind::Logged) return;
        const bool read = traffic.kind == Traffic::Kind::Read;
        if (read) ++answers;
        if (traffic.status < 0) ++failures;
        m_print((read ? "<- " : "-> ") + toText(printableLine(traffic.text, '.')).toStdString() +
                (traffic.status < 0 ? "  [" + std::to_string(traffic.status) + "]" : ""));
    }

    int answers = 0;
    int failures = 0;

private:
    Instrument& m_instrument;
    const std::function<void(const std::string&)>& m_print;
};

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

int makeTour(HMenue& window, Instrument& instrument, const TourDialogs& dialogs, const QString& folder,
             const std::function<void(const std::string&)>& print) {
    if (instrument.isOpen()) window.GTL_Taste_Click();  // opened at the start already: the tour shows how
    TrafficPrinter traffic(instrument, print);
    int failures = 0;
    window.show();
    window.INIT_Taste_Click();

    auto* pages = window.findChild<QTabWidget*>(QStringLiteral("SSTab1"));
    if (!QDir().mkpath(folder)) ++failures;
    int pictures = 0;
    for (int page = 0; page < pages->count(); ++page) {
        pages->setCurrentIndex(page);
        QCoreApplication::processEvents();
        if (!window.isVisible()) {
            ++failures;  // the program is to end
            break;
        }
        const QString file = QDir(folder).filePath(QStringLiteral("page_%1.png").arg(page));
        if (isPlainOrMissing(file) && window.grab().save(file)) {
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
    if (traffic.answers == 0) ++failures;
    failures += traffic.failures + dialogs.count();
    print(std::to_string(pictures) + " pictures, " + std::to_string(traffic.answers) + " answers, " +
          std::to_string(failures) + " failures");
    return failures == 0 ? 0 : 1;
}

}  // namespace kdx
