#include "window/settingsdialog.h"

#include <gtest/gtest.h>

#include <QDoubleSpinBox>
#include <QListWidget>
#include <QPushButton>
#include <QScrollArea>
#include <QSpinBox>

#include <chrono>
#include <set>
#include <thread>

#include "settings/corrections.h"
#include "support/everyfont.h"
#include "support/pagetest.h"
#include "support/windowtest.h"

namespace kdx::test {
namespace {

class SettingsDialogTest : public WindowTest {
protected:
    SettingsDialogTest() {
        folder.copyShipped();
        start();
    }
    QWidget* open() {
        action("Mnu_Einstellungen")->trigger();
        auto* dialog = find<QDialog>("SettingsDialog");
        EXPECT_TRUE(dialog->isVisible());
        return dialog;
    }
    std::string correction(const char* key) { return general("Berichtigungen", key); }
    static std::string box(const char* key) { return std::string("Berichtigung_") + key; }
};

TEST_F(SettingsDialogTest, ShowsWhatIsStored) {
    setGeneral("BUS", "IECBUS", "auto");
    setGeneral("RDS", "PS_Dyn", "1800");
    open();
    EXPECT_TRUE(checked("Log_Schalter"));
    EXPECT_TRUE(checked("Auto_Schalter"));
    EXPECT_EQ(find<QSpinBox>("PS_Dyn_Zahl")->value(), 1800);
    EXPECT_EQ(find<QDoubleSpinBox>("FM_Ulim_Zahl")->value(), 65);
    EXPECT_EQ(find<QDoubleSpinBox>("NF_Olim_Zahl")->value(), 15.1);
    EXPECT_TRUE(checked("Berichtigung_Mitternacht"));
    EXPECT_FALSE(checked("Berichtigung_Komma"));
    EXPECT_EQ(text("Sprache_Wahl"), "deutsch");
}

TEST_F(SettingsDialogTest, OpeningItStoresNothing) {
    const std::string before = folder.read("RDS_Allg.INI") + folder.read("Datenset1.INI");
    open();
    EXPECT_EQ(folder.read("RDS_Allg.INI") + folder.read("Datenset1.INI"), before);
}

TEST_F(SettingsDialogTest, TheLogIsSwitchedAtOnceAndKept) {
    open();
    click("Log_Schalter");
    EXPECT_FALSE(state.LogEnabled);
    EXPECT_EQ(general("ADRESSEN", "Log_Key"), "0");
    click("Log_Schalter");
    EXPECT_TRUE(state.LogEnabled);
    EXPECT_EQ(general("ADRESSEN", "Log_Key"), "1");
}

TEST_F(SettingsDialogTest, ConnectingAtTheStartIsStoredAsDescribed) {
    open();
    click("Auto_Schalter");
    EXPECT_EQ(general("BUS", "IECBUS"), "AUTO");
    start();
    EXPECT_FALSE(sent().empty());
    open();
    click("Auto_Schalter");
    EXPECT_EQ(general("BUS", "IECBUS"), "MANUAL");
}

TEST_F(SettingsDialogTest, IntervalAndLimitsAreStoredWhereTheyAreRead) {
    open();
    find<QSpinBox>("PS_Dyn_Zahl")->setValue(3000);
    find<QDoubleSpinBox>("FM_Ulim_Zahl")->setValue(87.5);
    find<QDoubleSpinBox>("FM_Olim_Zahl")->setValue(108);
    find<QDoubleSpinBox>("NF_Ulim_Zahl")->setValue(0.02);
    find<QDoubleSpinBox>("NF_Olim_Zahl")->setValue(15);
    EXPECT_EQ(general("RDS", "PS_Dyn"), "3000");
    const auto limit = [this](const char* key) { return data.ReadIni("VRN", key, "Datenset1.INI"); };
    EXPECT_EQ(limit("FM_Ulim"), "87.5");
    EXPECT_EQ(limit("FM_Olim"), "108");
    EXPECT_EQ(limit("NF_Ulim"), "0.02");
    EXPECT_EQ(limit("NF_Olim"), "15");
}

TEST_F(SettingsDialogTest, TheLanguageIsChangedEverywhere) {
    const QWidget* dialog = open();
    select("Sprache_Wahl", 1);
    EXPECT_EQ(general("Sprache", "Sprache"), "english");
    EXPECT_EQ(dialog->windowTitle().toStdString(), "Settings");
    EXPECT_EQ(text("PS_Taste"), "send");
    select("RDS_RBDS_Wahl", 1);
    EXPECT_EQ(general("Sprache", "RDS_RBDS"), "RBDS");
    EXPECT_EQ(state.standard, "RBDS");
}

TEST_F(SettingsDialogTest, EachCorrectionHasASwitchWithASentence) {
    open();
    for (const auto& [key, isOn] : kCorrectionKeys) {
        const bool before = state.corrections.*isOn;
        EXPECT_FALSE(find(box(key).c_str())->toolTip().isEmpty()) << key;
        click(box(key).c_str());
        EXPECT_EQ(correction(key), before ? "0" : "1") << key;
        EXPECT_EQ(state.corrections.*isOn, !before) << key;
        click(box(key).c_str());
        EXPECT_EQ(state.corrections.*isOn, before) << key;
    }
}

TEST_F(SettingsDialogTest, EachSentenceSaysWhatHappensWithoutAndWithTheCorrection) {
    struct Words {
        const char* language;
        const char* without;
        const char* with;
    };
    for (const auto& [language, without, with] :
         {Words{"deutsch", "Ohne ", " mit "}, Words{"english", "Without, ", "; with, "},
          Words{"english US", "Without, ", "; with, "}}) {
        setGeneral("Sprache", "Sprache", language);
        start();
        open();
        std::set<QString> titles;
        for (const auto& [key, isOn] : kCorrectionKeys) {
            const auto* correction = find<QCheckBox>(box(key).c_str());
            const QString sentence = correction->toolTip();
            EXPECT_TRUE(sentence.startsWith(QLatin1String(without))) << language << " " << sentence.toStdString();
            const auto at = sentence.indexOf(QLatin1String(with));
            EXPECT_GT(at, 10) << language << " " << sentence.toStdString();
            EXPECT_GT(sentence.size() - at, 9) << language << " " << sentence.toStdString();
            EXPECT_TRUE(titles.insert(correction->text()).second) << language << " " << key;
            const auto labels = correction->parentWidget()->findChildren<QLabel*>();
            EXPECT_TRUE(
                std::any_of(labels.begin(), labels.end(), [&](auto* label) { return label->text() == sentence; }))
                << language << " " << key << " shows another";
        }
    }
}

TEST_F(SettingsDialogTest, AllCorrectionsAreOneClick) {
    open();
    EXPECT_EQ(find<QCheckBox>("Alle_Berichtigungen")->checkState(), Qt::PartiallyChecked);
    click("Alle_Berichtigungen");
    for (const auto& [key, isOn] : kCorrectionKeys) {
        EXPECT_EQ(correction(key), "1") << key;
        EXPECT_TRUE(state.corrections.*isOn) << key;
        EXPECT_TRUE(checked(box(key).c_str())) << key;
    }
    EXPECT_TRUE(clock.midnightCorrected());
    click("Alle_Berichtigungen");
    for (const auto& [key, isOn] : kCorrectionKeys) EXPECT_FALSE(state.corrections.*isOn) << key;
    EXPECT_FALSE(clock.midnightCorrected());
    click("Berichtigung_Pegel");
    EXPECT_EQ(find<QCheckBox>("Alle_Berichtigungen")->checkState(), Qt::PartiallyChecked);
}

TEST_F(SettingsDialogTest, ACorrectionHoldsForTheNextCommand) {
    openSession();
    open();
    click("Berichtigung_Anfuehrung");
    visa.written.clear();
    type("PS_T", "A\"B");
    EXPECT_NE(find<QLineEdit>("PS_T")->palette().color(QPalette::Text), Qt::red);
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{R"(:STEREO:DIRECT "PS=A""B     ")"});
    click("Berichtigung_Anfuehrung");
    EXPECT_EQ(find<QLineEdit>("PS_T")->palette().color(QPalette::Text), Qt::red);
}

TEST_F(SettingsDialogTest, ThePageAndWhatIsComposedThereStayWhenACorrectionIsSwitched) {
    openSession();
    showPage(3);
    click("newList");
    click("Gruppe0");
    open();
    click("Berichtigung_Komma");
    EXPECT_EQ(find<QTabWidget>("SSTab1")->currentIndex(), 3);
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,");
}

TEST_F(SettingsDialogTest, AddressesUsedBeforeCanBeUsedAgain) {
    placeFile = folder.path() / "window.ini";
    start();
    openSession();
    click("GTL_Taste");
    dialogs.inputs = {QStringLiteral("192.168.0.7")};
    press("Adr1_Label", Qt::Key_Return);
    openSession();
    open();
    auto* list = find<QListWidget>("Adressen_Liste");
    ASSERT_EQ(list->count(), 2);
    EXPECT_EQ(list->item(0)->text().toStdString(), "TCPIP 192.168.0.7") << "the latest first";
    list->setCurrentRow(1);
    EXPECT_FALSE(find("Adressen_Verwenden")->isEnabled()) << "a session is open";
    click("GTL_Taste");
    list->setCurrentRow(1);
    click("Adressen_Verwenden");
    EXPECT_EQ(text("Adr1_Label"), "127.0.0.1");
    EXPECT_EQ(general("ADRESSEN", "KDX_TCPIP"), "127.0.0.1");
}

TEST_F(SettingsDialogTest, NothingIsCutOffInAnyLanguageAtAnySizeOfLetters) {
    for (int page = 0; page < 3; ++page) {
        expectNothingCutOffAnywhere([this, page](const char* language) -> QWidget& {
            setGeneral("Sprache", "Sprache", language);
            start();
            QWidget* dialog = open();
            auto* tabs = dialog->findChild<QTabWidget*>();
            EXPECT_EQ(tabs->count(), 3);
            tabs->setCurrentIndex(page);
            return *dialog;
        });
    }
}

/// The dialog on its own, with a network that is made up.
class AddressSearchTest : public PageTest {
protected:
    QWidget& root() override { return dialog; }
    void waitForEnd() {
        const auto latest = std::chrono::steady_clock::now() + std::chrono::seconds(20);
        while (!find("Adressen_Suchen")->isEnabled() && std::chrono::steady_clock::now() < latest)
            QCoreApplication::processEvents();
        EXPECT_TRUE(find("Adressen_Suchen")->isEnabled());
    }

    std::vector<std::string> network{"10.0.0.7", "10.0.0.9"};
    SettingsDialog dialog{context, [this](const std::function<bool()>& /*stopped*/) { return network; }, nullptr};
};

TEST_F(AddressSearchTest, InstrumentsInTheNetworkJoinTheList) {
    dialog.addresses().show({QStringLiteral("IEC 28"), QStringLiteral("TCPIP 10.0.0.7")});
    QStringList used;
    QObject::connect(&dialog.addresses(), &AddressesPage::chosen, &dialog,
                     [&used](const QString& kind, const QString& address) { used << kind << address; });
    click("Adressen_Suchen");
    EXPECT_FALSE(find("Adressen_Suchen")->isEnabled());
    waitForEnd();
    auto* list = find<QListWidget>("Adressen_Liste");
    ASSERT_EQ(list->count(), 3);
    list->setCurrentRow(2);
    click("Adressen_Verwenden");
    EXPECT_EQ(used, (QStringList{QStringLiteral("TCPIP"), QStringLiteral("10.0.0.9")}));
}

TEST_F(AddressSearchTest, AnEmptyNetworkIsToldAndCanBeSearchedAgain) {
    network.clear();
    click("Adressen_Suchen");
    waitForEnd();
    EXPECT_EQ(find<QListWidget>("Adressen_Liste")->count(), 0);
    network = {"10.0.0.1"};
    click("Adressen_Suchen");
    waitForEnd();
    EXPECT_EQ(find<QListWidget>("Adressen_Liste")->count(), 1);
}

TEST(AddressSearch, EndsWithItsDialog) {
    // A search that only the end of the dialog ends: the test would hang otherwise.
    struct Alone : PageTest {
        QWidget& root() override { return *page; }
        void TestBody() override {}
        void run() {
            page = std::make_unique<AddressesPage>(
                context,
                [](const std::function<bool()>& stopped) {
                    while (!stopped()) std::this_thread::yield();
                    return std::vector<std::string>{};
                },
                nullptr);
            click("Adressen_Suchen");
            page.reset();
        }
        std::unique_ptr<AddressesPage> page;
    };
    Alone alone;
    alone.run();
    EXPECT_EQ(alone.page, nullptr);
}

}  // namespace
}  // namespace kdx::test
