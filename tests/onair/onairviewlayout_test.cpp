#include <QHeaderView>

#include "onairviewtest.h"
#include "support/everyfont.h"

namespace kdx::test {
namespace {

constexpr const char* kTables[] = {"Air_AF", "Air_EON", "Air_TMC", "Air_Gruppen", "Air_Budget"};

class OnAirViewLayoutTest : public OnAirViewTest {
protected:
    void openFull(const char* language) {
        open(language);
        click("Taste_AF_Senden");
        sendMessage();
        session->params.SendParam("RT", std::string(64, 'W'));
        session->params.SendParam("GROUPSEQ", "0A,2A,8A");
        listen();
        QCoreApplication::processEvents();
    }
};

TEST_F(OnAirViewLayoutTest, NothingIsCutOffInAnyLanguageAtAnySizeOfLetters) {
    expectNothingCutOffAnywhere([this](const char* language) -> QWidget& {
        openFull(language);
        for (const char* name : kTables) {
            const QTableWidget* shown = table(name);
            for (int column = 0; column < shown->columnCount(); ++column) {
                const auto* header = shown->horizontalHeader();
                if (header->isHidden()) continue;
                const QString heading = shown->horizontalHeaderItem(column)->text();
                EXPECT_GE(header->sectionSize(column), header->fontMetrics().horizontalAdvance(heading))
                    << language << ' ' << name << ' ' << column;
            }
            EXPECT_LE(shown->horizontalHeader()->length(), shown->viewport()->width()) << language << ' ' << name;
        }
        const QSize least = view->minimumSizeHint();
        EXPECT_TRUE(least.width() <= 1024 && least.height() <= 740)
            << "a small screen has room: " << least.width() << " x " << least.height();
        return *view;
    });
}

TEST_F(OnAirViewLayoutTest, EveryControlCanBeReachedAndHasAName) {
    for (const char* language : kEveryLanguage) {
        openFull(language);
        for (const char* name : {"Air_AF", "Air_EON", "Air_TMC", "Air_Gruppen", "Air_Budget", "Air_PS", "Air_RT",
                                 "Air_PI", "Air_PTY", "Air_TP", "Air_TA", "Air_MS", "Air_CT"}) {
            EXPECT_FALSE(find(name)->accessibleName().isEmpty()) << language << ' ' << name;
            EXPECT_TRUE(find(name)->focusPolicy() & Qt::TabFocus) << name;
        }
        std::map<QString, QString> mnemonics;
        for (const QAbstractButton* button : view->findChildren<QAbstractButton*>()) {
            if (button->text().isEmpty()) continue;
            const QString key = QKeySequence::mnemonic(button->text()).toString();
            EXPECT_FALSE(key.isEmpty()) << button->text().toStdString();
            EXPECT_TRUE(mnemonics.emplace(key, button->text()).second) << language << ' ' << key.toStdString();
        }
    }
}

}  // namespace
}  // namespace kdx::test
