// Every control of the pages is used as a user does, over the network and with nothing replaced but the clock and the
// boxes; a second client of the same instrument reads back what has arrived.
#include <gtest/gtest.h>

#include <QGroupBox>
#include <QListWidget>
#include <QTimer>

#include <array>
#include <set>
#include <thread>

#include "link/lanvisa.h"
#include "sim/virtualinstrument.h"
#include "simserver/vxi11server.h"
#include "support/windowtest.h"
#include "ui/clickablelabel.h"

namespace kdx::test {
namespace {

/// The virtual instrument as a network device; only the server's thread comes near it.
class InstrumentDevice final : public sim::MessageDevice {
public:
    std::string execute(std::string_view message) override { return m_instrument.execute(message); }
    void clear() override { m_instrument.deviceClear(); }
    unsigned char statusByte() override { return m_instrument.statusByte(); }
    void unansweredRead() override { m_instrument.reportUnansweredRead(); }

private:
    FakeClock m_clock;  // stands still: the coder answers the very time it was given
    sim::VirtualInstrument m_instrument{m_clock};
};

/// A VXI-11 instrument of this machine, in a thread of its own.
class NetworkInstrument {
public:
    NetworkInstrument() : m_thread([this] { m_server.run(); }) {}
    ~NetworkInstrument() {
        m_server.stop();
        m_thread.join();
    }
    NetworkInstrument(const NetworkInstrument&) = delete;
    NetworkInstrument& operator=(const NetworkInstrument&) = delete;
    [[nodiscard]] LanOptions reachedBy() const {
        LanOptions options;
        options.corePort = m_server.corePort();
        return options;
    }

private:
    InstrumentDevice m_device;
    simserver::Vxi11Server m_server{m_device};
    std::thread m_thread;
};

/// Another client of the same instrument.
class Observer {
public:
    explicit Observer(const LanOptions& options) : m_visa(options) {
        VisaHandle manager = 0;
        m_visa.viOpenDefaultRM(manager);
        EXPECT_EQ(m_visa.viOpen(manager, "TCPIP::127.0.0.1::INSTR", 0, 0, m_session), visa::kSuccess);
    }
    void tell(const std::string& command) {
        std::int32_t written = 0;
        EXPECT_EQ(m_visa.viWrite(m_session, command, written), visa::kSuccess);
    }
    /// The whole answer without its line end.
    std::string ask(const std::string& query) {
        tell(query);
        std::string answer;
        VisaStatus status = visa::kMaxCountReached;
        while (status == visa::kMaxCountReached) {
            std::array<char, 256> buffer{};
            std::int32_t count = 0;
            status = m_visa.viRead(m_session, buffer, count);
            answer.append(buffer.data(), static_cast<std::size_t>(count));
        }
        EXPECT_EQ(status, visa::kSuccess) << query;
        return answer.substr(0, answer.find('\n'));
    }
    /// A value of the coder, without the quotes around it.
    std::string askCoder(const std::string& name) {
        const std::string answer = ask(":STEREO:DIRECT? \"" + name + "\"");
        return answer.size() < 2 ? answer : answer.substr(1, answer.size() - 2);
    }
    /// Takes everything out of the error queue.
    Lines errors() {
        Lines errors;
        for (;;) {
            const std::string error = ask("SYST:ERR?");
            if (error.starts_with("0,")) return errors;
            errors.push_back(error);
        }
    }

private:
    LanVisa m_visa;
    VisaHandle m_session = 0;
};

const Lines kNoErrors;
const Lines kIllegalValue = {R"(-224,"Illegal parameter value")"};

class EverySetting : public WindowTest {
protected:
    void SetUp() override {
        folder.copyShipped();
        window = std::make_unique<HMenue>(
            Surroundings{lan, state, data, captions, clock, dialogs, QStringLiteral("network"), [] {}});
        window->startUp();
        window->show();
        openSession();
        ASSERT_TRUE(state.InstrumentOnline);
        EXPECT_TRUE(window->windowTitle().startsWith(QString::fromLatin1(sim::kDefaultIdentification)));
        // Before the data set's network goes out those that the coder holds are deleted. It holds none, and the one
        // delete that is sent all the same names nothing.
        EXPECT_EQ(observer.errors(), kIllegalValue);
    }
    void TearDown() override { EXPECT_EQ(observer.errors(), kNoErrors); }

    // What is used is written down.
    void click(const std::string& name) {
        m_used.insert(name);
        ASSERT_TRUE(find(name.c_str())->isEnabled()) << name;
        WindowTest::click(name.c_str());
    }
    void type(const char* name, const char* utf8) {
        m_used.insert(name);
        WindowTest::type(name, utf8);
    }
    void scroll(const char* name, int value) {
        m_used.insert(name);
        WindowTest::scroll(name, value);
    }
    void select(const char* name, int index) {
        m_used.insert(name);
        WindowTest::select(name, index);
    }
    void clickLabel(const char* name) {
        m_used.insert(name);
        emit find<ClickableLabel>(name)->clicked();
    }
    static std::string numbered(const char* name, int index) { return std::string(name) + "_" + std::to_string(index); }

    /// Moves a scroll bar to each value and compares what the instrument then has.
    void expectScroll(const char* name, const char* query, const std::vector<std::pair<int, const char*>>& values) {
        for (const auto& [value, answer] : values) {
            scroll(name, value);
            EXPECT_EQ(observer.ask(query), answer) << name << " at " << value;
        }
        EXPECT_EQ(observer.errors(), kNoErrors) << name;
    }
    /// Chooses the options in turn and compares what the instrument then has.
    void expectOptions(const char* name, const std::string& query, const Lines& answers) {
        for (std::size_t i = 0; i < answers.size(); ++i) {
            click(numbered(name, static_cast<int>(i)));
            EXPECT_EQ(observer.ask(query), answers[i]) << name << " " << i;
        }
        EXPECT_EQ(observer.errors(), kNoErrors) << name;
    }
    /// Turns a switch over and over again.
    void expectSwitch(const char* name, const char* query) {
        const std::string before = observer.ask(query);
        click(name);
        EXPECT_EQ(observer.ask(query), before == "1" ? "0" : "1") << name;
        click(name);
        EXPECT_EQ(observer.ask(query), before) << name;
        EXPECT_EQ(observer.errors(), kNoErrors) << name;
    }
    void expectCoder(const char* name, const std::string& answer) { EXPECT_EQ(observer.askCoder(name), answer); }

    /// Edits a list in the editor's own window, which the button opens: a list of the tuned frequency 99.9 with the
    /// AFs 88.1, 92.0 and 94.<number>.
    void editList(const char* button, int number) {
        dialogs.inputs = {QStringLiteral("99.94")};
        QTimer::singleShot(0, [this, number] {
            auto* editor = QApplication::activeModalWidget();
            ASSERT_NE(editor, nullptr);
            const auto press = [editor](const std::string& name) {
                editor->findChild<QAbstractButton*>(QString::fromStdString(name))->click();
            };
            auto* entry = editor->findChild<QLineEdit*>(QStringLiteral("Text2"));
            auto* list = editor->findChild<QListWidget*>(QStringLiteral("AF_List1"));
            press(numbered("AFList_Opt", number - 1));
            while (list->count() > 0) {
                dialogs.confirmations = {true};
                list->setCurrentRow(0);
                press("Rem_Freq");
            }
            emit editor->findChild<ClickableLabel*>(QStringLiteral("AF_TN"))->clicked();
            for (const std::string& frequency : {std::string("88.1"), "94." + std::to_string(number)}) {
                entry->setText(QString::fromStdString(frequency));
                press("Command1");
            }
            entry->setText(QStringLiteral("92.0"));
            list->setCurrentRow(1);
            press("AF_OF_add");
            press("Uebernahme_Knopf");
        });
        click(button);
    }
    static std::string edited(int number) { return "99.9,88.1,92.0,94." + std::to_string(number); }
    static std::string editedPairs(int number) { return "99.9,99.9,88.1,99.9,92.0,99.9,94." + std::to_string(number); }

    /// Whether every control of the page that a user could change has been used, but for those named.
    void expectAllUsed(int page, const std::set<std::string>& others = {}) {
        const auto* tabs = find<QTabWidget>("SSTab1");
        std::set<std::string> left;
        for (const QWidget* control : tabs->widget(page)->findChildren<QWidget*>()) {
            const bool changes = qobject_cast<const QAbstractButton*>(control) != nullptr ||
                                 qobject_cast<const QScrollBar*>(control) != nullptr ||
                                 qobject_cast<const QComboBox*>(control) != nullptr ||
                                 qobject_cast<const QLineEdit*>(control) != nullptr ||
                                 qobject_cast<const ClickableLabel*>(control) != nullptr;
            const std::string name = control->objectName().toStdString();
            const bool ours = !name.empty() && !name.starts_with("qt_");
            if (changes && ours && !m_used.contains(name)) left.insert(name);
        }
        EXPECT_EQ(left, others);
    }

    NetworkInstrument instrument;
    LanVisa lan{instrument.reachedBy()};
    Observer observer{instrument.reachedBy()};

private:
    std::set<std::string> m_used;
};

TEST_F(EverySetting, OfTheStereoPageArrives) {
    showPage(0);
    expectScroll("FM_Hub_Scroll", ":STEREO:DEVIATION?", {{8000, "80000"}, {10, "100"}, {0, "0"}, {7500, "75000"}});
    click("FM_Source_Opt_0");
    EXPECT_EQ(observer.ask("STEREO:STAT?"), "0");
    for (const auto& [option, source] : {std::pair{1, "LREXT"}, {2, "SPEXT"}, {3, "LFGEN"}}) {
        click(numbered("FM_Source_Opt", option));
        EXPECT_EQ(observer.ask("STEREO:STAT?;:STEREO:SOURCE?"), "1;" + std::string(source));
    }
    // The instrument's parameter counts the impedances from 1, the options count from 0: the first one sends nothing,
    // the second one the first impedance.
    observer.tell(":STEREO:EXTERNAL:IMP 100000");
    expectOptions("FM_Imp_Opt", ":STEREO:EXTERNAL:IMP?", {"100000", "600"});
    expectOptions("Pre_opt", ":STEREO:AUDIO:PRE:STAT?;:STEREO:AUDIO:PRE?", {"0;50US", "1;50US", "1;75US"});
    // The stereo modes are counted in the same two ways.
    observer.tell(":STEREO:AUDIO:MODE RNEL");
    expectOptions("Stereo_Opt", ":STEREO:AUDIO:MODE?", {"RNEL", "LEFT", "RIGHT", "REL", "REML"});
    expectSwitch("Pilot_OnOff", ":STEREO:PILOT:STATE?");
    expectScroll("Pilot_Hub_Scroll", ":STEREO:PILOT:DEVIATION?", {{1500, "15000"}, {5, "50"}, {0, "0"}, {675, "6750"}});
    expectScroll("HScroll1", ":STEREO:PILOT:PHASE?", {{-4, "-4"}, {0, "0"}, {5, "5"}, {2, "2"}});
    expectSwitch("RDS_OnOff", ":STEREO:RDS:STATE?");
    expectScroll("RDS_Hub_Scroll", ":STEREO:RDS:DEVIATION?", {{400, "4000"}, {5, "50"}, {0, "0"}, {200, "2000"}});
    expectSwitch("Ari_OnOff", ":STEREO:ARI:STATE?");
    expectScroll("Ari_hub_Scroll", ":STEREO:ARI:DEVIATION?", {{800, "8000"}, {5, "50"}, {0, "0"}, {350, "3500"}});
    expectOptions("ARI_Mode_Opt", ":STEREO:ARI:TYPE:STATE?;:STEREO:ARI:TYPE?", {"0;DK", "1;DK", "1;BK", "1;BKDK"});
    expectOptions("BK_Opt", ":STEREO:ARI:BK?", {"A", "B", "C", "D", "E", "F"});

    click("Taste_DATA_MODE");
    expectCoder("BIN", "1");
    for (int pattern = 3; pattern >= 0; --pattern) {
        click(numbered("TestDat_Opt", pattern));
        expectCoder("BIN", std::to_string(pattern + 1));
    }
    click("Taste_DATA_MODE");
    expectCoder("BIN", "0");

    click("Btn_SetRdsStereo");
    expectAllUsed(0, {"RDS_Phase_Scroll"});  // hidden: the program has no command for it
}

TEST_F(EverySetting, OfTheRdsPageArrives) {
    showPage(1);
    type("PS_T", "Grün 1");
    click("PS_Taste");
    expectCoder("PS", "Gr\xFCn 1  ");
    type("PI_T", "D3C2");
    click("Command3");
    expectCoder("PI", "D3C2");
    for (const int programmeType : {31, 0, 10}) {
        select("PTY_Combo1", programmeType);
        expectCoder("PTY", (programmeType < 10 ? "0" : "") + std::to_string(programmeType));
    }
    click("Check1");
    EXPECT_EQ(observer.ask(":STEREO:RDS:TRAFFIC:PROGRAM?"), "1");
    for (const char* flag : {"1", "0"}) {
        click("TA_Check");
        expectCoder("TA", flag);
    }
    click("Check1");
    EXPECT_EQ(observer.ask(":STEREO:RDS:TRAFFIC:PROGRAM?"), "0");
    click("MS_opt_1");
    expectCoder("MS", "S");
    click("MS_opt_0");
    expectCoder("MS", "M");
    for (int info = 15; info >= 0; --info) {
        click(numbered("DI_Opt", info));
        expectCoder("DI", std::to_string(info));
    }
    type("RT_Text1", "Radiotext, mit Komma");
    click("RT_Taste1");
    expectCoder("RT", "Radiotext, mit Komma");
    expectCoder("RT-N", "10,0");
    click("RT_clear1");
    expectCoder("RT", "   ");
    clock.set(8 * 3600 + 15 * 60 + 30);
    ASSERT_TRUE(tick("Timer1"));
    expectCoder("CT", "08:15:30,05.03.09");
    click("Zeit_Taste");  // off: the coder's clock runs on
    expectCoder("CT", "08:15:30,05.03.09");
    // What sends only as time goes by, and what only explains.
    expectAllUsed(1, {"PS_dyn_Check", "Taste_PS_Auto", "TA_EON_Hilfe", "TA_HScroll", "TA_Option_0", "TA_Option_1",
                      "TA_Rep_HScroll", "Uhr_Zeit"});
}

TEST_F(EverySetting, OfTheListPageArrives) {
    showPage(2);
    for (int number = 1; number <= 5; ++number) {
        click(numbered("AFList_Opt", number - 1));
        editList("AF_Bearbeiten", number);
        EXPECT_EQ(text("AF_TN"), "99.9") << number;
    }
    click("AFMethod_opt_1");
    click("Taste_AF_Senden");
    for (int number = 1; number <= 5; ++number) {
        expectCoder(("AF" + std::to_string(number)).c_str(), editedPairs(number));
    }
    click("AFMethod_opt_0");
    click("Taste_AF_Senden");
    for (int number = 1; number <= 5; ++number) {
        expectCoder(("AF" + std::to_string(number)).c_str(), edited(number));
    }
    expectAllUsed(2);
}

TEST_F(EverySetting, OfTheGroupPageArrives) {
    showPage(3);
    click("newList");
    std::string sequence;
    for (int group = 15; group >= 0; --group) {
        if (group == 4) continue;
        click("Gruppe" + std::to_string(group));
        sequence += (sequence.empty() ? "" : ",") + std::to_string(group) + "A";
    }
    click("GS_Senden");
    expectCoder("GS", sequence);
    EXPECT_FALSE(find("Gruppe4")->isEnabled());
    expectAllUsed(3, {"Gruppe4"});
}

TEST_F(EverySetting, OfTheOtherNetworkArrives) {
    // An announcement of the other network needs TP off and TA on here: TA can only be given while TP is on.
    for (const char* box : {"Check1", "TA_Check", "Check1"}) click(box);
    showPage(4);
    expectCoder("EON PI?", " D7A2,");
    type("EON_PI_Text", "D3C4");
    click("EON_PI_Taste");
    expectCoder("EON PI?", " D3C4,");
    type("EON_PS_Text", "ANDERES");
    click("EON_PS_Taste");
    expectCoder("EON-PS,D3C4", "ANDERES ");
    for (const char* flag : {"0", "1"}) {
        click("EON_TP_Check");
        expectCoder("EON-TP,D3C4", flag);
    }
    click("EON_TA_Schalter");
    expectCoder("EON-TA,D3C4", "1");
    ASSERT_TRUE(tick("EON_TA_Zeit"));
    expectCoder("EON-TA,D3C4", "0");
    EXPECT_FALSE(tick("EON_TA_Zeit"));
    for (int number = 1; number <= 5; ++number) {
        click(numbered("EON_AFB_Opt", number - 1));
        editList("EON_AF_Bearbeiten", number);
        EXPECT_EQ(text("Tuned_AFB"), "99.9") << number;
    }
    click("EON_AFB_Senden");
    for (int number = 1; number <= 5; ++number) {
        expectCoder(("EON-AFB,D3C4," + std::to_string(number)).c_str(), edited(number));
    }
    EXPECT_EQ(observer.errors(), kNoErrors);
    // The type's name goes out in place of a PI, which the coder refuses: networks and types stay as they were.
    select("EON_PTY_Combo", 10);
    EXPECT_EQ(observer.errors(), kIllegalValue);
    expectCoder("EON PI?", " D3C4,");
    expectCoder("EON-PTY,D3C4", "00");
    expectAllUsed(4);
}

TEST_F(EverySetting, OfTheMemoryPageArrives) {
    showPage(6);
    for (int memory = 4; memory >= 0; --memory) click(numbered("Store_Taste", memory));
    expectCoder("STORE", "1,2,3,4,5");
    expectAllUsed(6);
}

TEST_F(EverySetting, OfTheGeneratorPageArrives) {
    showPage(8);
    const std::tuple<const char*, const char*, const char*, const char*> values[] = {
        {"Input_HF_Freq_Label", "101.25", "FREQ?", "101.25"},
        {"Input_HF_Pegel_Label", "66.5", "POW?", "66.5"},
        {"Input_AF_Freq_Label", "0.4", ":STEREO:AUDIO:FREQ?", "0.4"}};
    for (const auto& [label, typed, query, answer] : values) {
        dialogs.inputs = {QString::fromLatin1(typed)};
        clickLabel(label);
        EXPECT_EQ(observer.ask(query), answer) << label;
    }
    EXPECT_EQ(observer.ask(":OUTPUT:STAT?"), "1") << "the opening has switched it on";
    expectSwitch("HfOnOffState", ":OUTPUT:STAT?");
    expectAllUsed(8);
}

/// The values that a data set brings the instrument.
class WholeDataSet : public EverySetting {
protected:
    Lines values() {
        Lines values;
        for (const char* query :
             {":STEREO:AUDIO:PRE?", ":STEREO:AUDIO:PRE:STAT?", ":STEREO:PILOT:STATE?", ":STEREO:PILOT:DEV?",
              ":STEREO:PILOT:PHASE?", ":STEREO:ARI:STATE?", ":STEREO:RDS:STATE?", ":STEREO:RDS:DEV?",
              ":STEREO:RDS:TRAFFIC:PROGRAM?", "FREQ?", "POW?"}) {
            values.push_back(query + observer.ask(query));
        }
        for (const char* name :
             {"PI", "TA", "PS", "BIN", "MS", "RT", "AF1", "AF2", "AF3", "AF4", "AF5", "PTY", "EON-PI", "EON-TA,D3C4",
              "EON-TP,D3C4", "EON-PS,D3C4", "EON-AFB,D3C4,1", "EON-AFB,D3C4,5", "GS"}) {
            values.push_back(name + (" " + observer.askCoder(name)));
        }
        return values;
    }
};

TEST_F(WholeDataSet, BringsAnInstrumentThatWasResetBackToWhereItWas) {
    // Away from what the instrument has after a reset, and from what was stored.
    click("Pre_opt_2");
    scroll("Pilot_Hub_Scroll", 700);
    scroll("HScroll1", -3);
    click("Ari_OnOff");
    scroll("RDS_Hub_Scroll", 150);
    type("PI_T", "D3C2");
    click("Command3");
    click("Check1");
    click("TA_Check");
    type("PS_T", "ANDERES");
    click("PS_Taste");
    click("MS_opt_1");
    type("RT_Text1", "Anderer Text");
    click("RT_Taste1");
    select("PTY_Combo1", 3);
    type("EON_PI_Text", "D3C4");
    click("EON_PI_Taste");
    type("EON_PS_Text", "DRITTES");
    click("EON_PS_Taste");
    click("EON_TP_Check");
    click("EON_TP_Check");
    click("EON_AFB_Senden");
    click("Gruppe3");
    click("GS_Senden");
    const Lines before = values();
    observer.tell("*RST");
    EXPECT_NE(observer.askCoder("PS"), "ANDERES ");
    EXPECT_EQ(observer.errors(), kNoErrors);
    click("Btn_SetRdsStereo");
    EXPECT_EQ(values(), before);
    EXPECT_EQ(observer.errors(), kIllegalValue) << "the one delete without a network";
}

}  // namespace
}  // namespace kdx::test
