// Everything at once for a long time: dynamic PS, announcement automation, clock, cycling messages and a user who
// presses whatever there is, over VXI-11 on the loopback interface. The clock of the test makes hours of it pass in
// seconds.
#include <gtest/gtest.h>

#include <QDialog>

#include <filesystem>
#include <fstream>
#include <map>
#include <random>
#include <set>

#include "support/networkinstrument.h"
#include "support/virtualtime.h"
#include "support/windowtest.h"
#include "ui/application.h"

#include <unistd.h>

namespace kdx::test {
namespace {

constexpr std::size_t kWarmUpCommands = 2500;  // until the live view of the commands is full
constexpr std::size_t kCommands = kWarmUpCommands + 10000;
constexpr double kLargestGrowthMib = 1;

/// Temporary folders in memory, where the system has them: every change of a setting is forced onto the disk, and on a
/// slow one this would take most of the time.
class FoldersInMemory {
protected:
    FoldersInMemory() {
        if (std::filesystem::is_directory(kMemory)) qputenv("TMPDIR", kMemory);
    }
    ~FoldersInMemory() { m_before.isNull() ? qunsetenv("TMPDIR") : qputenv("TMPDIR", m_before); }
    FoldersInMemory(const FoldersInMemory&) = delete;
    FoldersInMemory& operator=(const FoldersInMemory&) = delete;

private:
    static constexpr const char* kMemory = "/dev/shm";
    QByteArray m_before = qgetenv("TMPDIR");
};

/// Cancels every input; a failure box fails the test, a word about what cannot be done does not.
class SoakDialogs final : public Dialogs {
public:
    void message(Icon icon, const QString& title, const QString& text, const QString&) override {
        if (icon == Icon::Critical) fail(title, text);
    }
    bool messageOrStop(const QString& title, const QString& text, const QString&, const QString&, Icon) override {
        fail(title, text);
        return true;
    }
    bool confirm(const QString&, const QString&) override { return false; }
    QString input(const QString&, const QString&, const QString&) override { return {}; }

private:
    static void fail(const QString& title, const QString& text) {
        ADD_FAILURE() << "box: " << title.toStdString() << " | " << text.toStdString();
    }
};

/// Memory that the process holds, in MiB.
double residentMib() {
    long pages = 0;
    long resident = 0;
    std::ifstream("/proc/self/statm") >> pages >> resident;
    return static_cast<double>(resident) * static_cast<double>(sysconf(_SC_PAGESIZE)) / (1024 * 1024);
}

/// Presses, chooses, scrolls and types at random, the same at every run.
class RandomUser {
public:
    explicit RandomUser(HMenue& window) : m_window(window) {}

    void act() {
        auto* pages = m_window.findChild<QTabWidget*>(QStringLiteral("SSTab1"));
        if (below(4) == 0) pages->setCurrentIndex(below(pages->count()));
        QWidgetList usable;
        for (QWidget* control : pages->currentWidget()->findChildren<QWidget*>()) {
            const std::string name = control->objectName().toStdString();
            if (!name.empty() && !kLeftAlone.contains(name) && control->isEnabled() && control->isVisible()) {
                usable << control;
            }
        }
        // Labels and frames among them do nothing, as for a user who hits them.
        if (!usable.isEmpty()) use(usable.at(below(static_cast<int>(usable.size()))));
    }
    [[nodiscard]] const std::set<std::string>& used() const { return m_used; }

private:
    // They would end what is to go on all the time, or open a window that waits for its user.
    inline static const std::set<std::string> kLeftAlone = {
        "Taste_PS_Auto", "TA_Option_0",      "TA_Option_1", "Check1",        "Zeit_Taste",        "Stop_Timer",
        "txtCycleTime",  "optSingleMessage", "GTL_Taste",   "AF_Bearbeiten", "EON_AF_Bearbeiten", "TMC_Senden_Taste",
    };

    // Without the double quote: it would end a coder command early, and the instrument would not answer a question.
    inline static const QString kLetters = QStringLiteral("ABCXYZabcxyz0123456789 .,;:-+/'#%&()?!");

    int below(int limit) { return static_cast<int>(m_random() % static_cast<unsigned>(limit)); }

    void use(QWidget* control) {
        if (auto* button = qobject_cast<QAbstractButton*>(control)) {
            button->click();
        } else if (auto* combo = qobject_cast<QComboBox*>(control); combo != nullptr && combo->count() > 0) {
            combo->setCurrentIndex(below(combo->count()));
            emit combo->activated(combo->currentIndex());
        } else if (auto* bar = qobject_cast<QScrollBar*>(control); bar != nullptr && !isTime(bar)) {
            bar->setValue(bar->minimum() + below(bar->maximum() - bar->minimum() + 1));
        } else if (auto* box = qobject_cast<QLineEdit*>(control)) {
            QString text;
            for (int i = below(std::min(box->maxLength(), 30) + 1); i > 0; --i)
                text += kLetters.at(below(static_cast<int>(kLetters.size())));
            box->setText(text);
        } else {
            return;
        }
        m_used.insert(control->objectName().toStdString());
    }
    /// The times of the announcements: set to an hour they would leave little of them.
    static bool isTime(const QScrollBar* bar) { return bar->objectName().startsWith(QLatin1String("TA_")); }

    HMenue& m_window;
    std::mt19937 m_random{20090305};
    std::set<std::string> m_used;
};

class SoakTest : FoldersInMemory, public WindowTest {
protected:
    SoakTest() {
        clock.set(10);
        folder.copyShipped();
        setGeneral("RDS", "PS_Dyn", "300");
        setGeneral("RDS", "TA_ON", "10");
        setGeneral("RDS", "TA_REP", "30");
        auto& application = dynamic_cast<Application&>(*QApplication::instance());
        application.onFailure([](const QString& where, const QString& error) {
            ADD_FAILURE() << where.toStdString() << ": " << error.toStdString();
        });
        LanOptions options = instrument.reachedBy();
        // A machine with much else to do is no failure here.
        options.ioTimeout = std::chrono::seconds(20);
        lan = std::make_unique<LanVisa>(options);
        heard = [this](const Traffic& traffic) { hear(traffic); };
        start();
        time = std::make_unique<VirtualTime>(clock, *window);
    }
    ~SoakTest() override {
        end();  // before what it works with
        dynamic_cast<Application&>(*QApplication::instance()).onFailure({});
    }

    void hear(const Traffic& traffic) {
        if (traffic.kind == Traffic::Kind::Logged) return;
        EXPECT_TRUE(traffic.kind == Traffic::Kind::Written ? traffic.status == 0 : traffic.status >= 0)
            << traffic.text << ": " << traffic.status;
        if (traffic.kind != Traffic::Kind::Written || traffic.text.empty()) return;  // nothing goes out for no text
        written.push_back(traffic.text);
        for (auto& [start, count] : commandsBeginning) {
            if (traffic.text.find(start) != std::string::npos) ++count;
        }
    }
    void startEverything() {
        openSession();
        click("Check1");
        if (!checked("Check1")) click("Check1");
        click("TA_Option_1");
        click("Taste_PS_Auto");
        for (int i = 0; i < 5; ++i) {
            select("TMC_Event_Combo", 3 * i);
            select("TMC_Loc_Combo", 2 * i);
            for (const char* control : {"TMC_F_Check", "TMC_T_Check", "TMC_Div", "Tmc_richtung_0"}) click(control);
            select("TMC_Var_Combo", i);
            select("DurationCombo", i);
            click("TMC_Gr8_apply");
        }
        click("optMultiMessage");
        type("txtCycleTime", "1.5");
        click("TMC_Senden_Taste");
        action("Mnu_Info_Log")->trigger();
    }
    /// What the instrument received since the last look is what the program wrote, in this order.
    void compare() {
        commands += written.size();
        const Lines received = instrument.takeReceived();
        const auto [sent, arrived] = std::mismatch(written.begin(), written.end(), received.begin(), received.end());
        const bool same = sent == written.end() && arrived == received.end();
        ASSERT_TRUE(same) << "written: " << (sent == written.end() ? "nothing more" : *sent)
                          << "\nreceived: " << (arrived == received.end() ? "nothing more" : *arrived) << "\nafter "
                          << commands << " commands";
        written.clear();
    }
    void runUntil(std::size_t limit) {
        while (commands < limit && !HasFailure()) {
            time->advance(std::chrono::seconds(1));
            user->act();
            QCoreApplication::processEvents();
            compare();
            ASSERT_LT(clock.secondsSinceMidnight(), 80000) << "the day is not long enough";
        }
    }

    Visa& instrumentLink() override { return *lan; }
    Dialogs& boxesOfWindow() override { return boxes; }

    SystemClock coderClock;
    NetworkInstrument instrument{coderClock};
    SoakDialogs boxes;
    std::unique_ptr<LanVisa> lan;
    std::unique_ptr<VirtualTime> time;
    std::unique_ptr<RandomUser> user;
    Lines written;
    std::size_t commands = 0;
    std::map<std::string, int> commandsBeginning = {{"\"PS=", 0}, {"\"TA=1", 0}, {"\"TA=0", 0},
                                                    {"\"CT=", 0}, {"\"3A=", 0},  {"\"8A=", 0}};
};

TEST_F(SoakTest, EverythingTogetherLosesNoCommandAndNoMemory) {
    startEverything();
    user = std::make_unique<RandomUser>(*window);
    runUntil(kWarmUpCommands);
    window->findChild<QDialog*>(QStringLiteral("LogView"))->close();
    const double warm = residentMib();
    runUntil(kCommands);
    ASSERT_FALSE(HasFailure());
    const double growth = residentMib() - warm;
#ifndef __SANITIZE_ADDRESS__  // which keeps freed memory back
    EXPECT_LT(growth, kLargestGrowthMib);
#endif
    RecordProperty("growthKib", static_cast<int>(growth * 1024));
    RecordProperty("virtualSeconds", static_cast<int>(clock.secondsSinceMidnight()));

    // All parts were at work, and all the time.
    const double seconds = clock.secondsSinceMidnight() - 10;
    EXPECT_GT(commandsBeginning["\"PS="], seconds * 2);
    EXPECT_GT(commandsBeginning["\"TA=1"], seconds / 10);
    EXPECT_GT(commandsBeginning["\"TA=0"], seconds / 100);
    EXPECT_GT(commandsBeginning["\"CT="], seconds / 25);
    EXPECT_GT(commandsBeginning["\"8A="], seconds / 3);
    EXPECT_EQ(commandsBeginning["\"3A="], commandsBeginning["\"8A="]);
    EXPECT_GT(user->used().size(), 100U) << "controls that the user found";
}

}  // namespace
}  // namespace kdx::test
