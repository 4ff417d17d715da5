#include "window/tour.h"

#include <QBuffer>
#include <QCoreApplication>
#include <QPixmap>
#include <QPushButton>
#include <QTabWidget>

#include <system_error>

#include "base/paths.h"
#include "base/printable.h"
#include "coder/readback.h"
#include "link/instrument.h"
#include "settings/durablefile.h"
#include "settings/shownpath.h"
#include "ui/text.h"
#include "window/hmenue.h"

namespace kdx {

namespace {

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

bool TourDialogs::messageOrStop(const QString& title, const QString& text, const QString& /*details*/,
                                const QString& /*stop*/, Icon /*icon*/) {
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

QString TourDialogs::fileToSave(const QString& title, const QString& preset, const QString& /*kind*/) {
    note(title, preset);
    return {};
}

QString TourDialogs::fileToOpen(const QString& title, const QString& kind, const QString& /*folder*/) {
    if (m_toOpen.empty()) note(title, kind);
    return QString::fromStdString(utf8Of(m_toOpen));
}

void TourDialogs::note(const QString& title, const QString& text) {
    ++m_count;
    m_print("!! " + title.toStdString() + ": " + text.simplified().toStdString());
}

bool savePicture(const QPixmap& picture, const std::filesystem::path& file) {
    QByteArray bytes;
    QBuffer buffer(&bytes);
    if (!buffer.open(QIODevice::WriteOnly) || !picture.save(&buffer, "PNG")) return false;
    return emptyPlainFile(file) && appendToPlainFile(file, {bytes.constData(), static_cast<std::size_t>(bytes.size())});
}

int makeTour(HMenue& window, Instrument& instrument, const TourDialogs& dialogs, const std::filesystem::path& folder,
             const std::function<void(const std::string&)>& print) {
    if (instrument.isOpen()) window.GTL_Taste_Click();  // opened at the start already: the tour shows how
    TrafficPrinter traffic(instrument, print);
    int failures = 0;
    window.show();
    window.INIT_Taste_Click();

    auto* pages = window.findChild<QTabWidget*>(QStringLiteral("SSTab1"));
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    if (error) ++failures;
    int pictures = 0;
    for (int page = 0; page < pages->count(); ++page) {
        pages->setCurrentIndex(page);
        QCoreApplication::processEvents();
        if (!window.isVisible()) {
            ++failures;  // the program is to end
            break;
        }
        const auto file = folder / ("page_" + std::to_string(page) + ".png");
        if (savePicture(window.grab(), file)) {
            ++pictures;
        } else {
            ++failures;
            print("!! cannot save " + shownPath(file));
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
