#include <QLabel>
#include <QLineEdit>
#include <QSet>

#include <cstdlib>
#include <memory>
#include <type_traits>

#include "rds/programme.h"
#include "rds/querypage.h"
#include "rds/rdspage.h"
#include "rds/storepage.h"
#include "support/pagetest.h"

namespace kdx::test {
namespace {

constexpr QSize kPageSize(620, 322);

/// The pages of this folder at the size they get in the window.
class PageLayout : public PageTest, public ::testing::WithParamInterface<const char*> {
protected:
    QWidget& root() override { return *m_page; }

    template <typename Shown>
    void show(const char* name) {
        folder.copyShipped();
        useLanguage(GetParam());
        auto page = make<Shown>();
        page->label();
        page->load();
        m_page = std::move(page);
        m_page->resize(kPageSize);
        m_page->show();
        QApplication::processEvents();
        savePicture(name);
    }
    void expectTidy() {
        const QSize least = m_page->minimumSizeHint();
        EXPECT_LE(least.width(), kPageSize.width());
        EXPECT_LE(least.height(), kPageSize.height());
        EXPECT_EQ(m_page->size(), kPageSize);
        expectNoOverlaps();
        expectMnemonicsUnique();
        expectEverythingNamed();
    }

    /// For a look at the page: KDX_SHOTS names the folder.
    void savePicture(const char* name) {
        const char* folderName = std::getenv("KDX_SHOTS");
        if (folderName == nullptr) return;
        const QString file = QStringLiteral("%1/%2_%3_%4x.png")
                                 .arg(QString::fromLocal8Bit(folderName), QString::fromLatin1(name),
                                      QString::fromLatin1(GetParam()).section(QLatin1Char(' '), -1))
                                 .arg(m_page->devicePixelRatioF());
        EXPECT_TRUE(m_page->grab().save(file)) << file.toStdString();
    }

private:
    template <typename Shown>
    std::unique_ptr<Shown> make() {
        if constexpr (std::is_same_v<Shown, RdsPage>) {
            m_programme.load(settings);
            return std::make_unique<RdsPage>(context, m_programme, nullptr);
        } else {
            return std::make_unique<Shown>(context, nullptr);
        }
    }

    void expectNoOverlaps() {
        const auto parents = m_page->findChildren<QWidget*>() << m_page.get();
        for (const QWidget* parent : parents) {
            const auto children = parent->findChildren<QWidget*>(QString(), Qt::FindDirectChildrenOnly);
            for (qsizetype a = 0; a < children.size(); ++a) {
                for (qsizetype b = a + 1; b < children.size(); ++b) {
                    if (!children[a]->isVisible() || !children[b]->isVisible()) continue;
                    EXPECT_FALSE(children[a]->geometry().intersects(children[b]->geometry()))
                        << children[a]->objectName().toStdString() << " and "
                        << children[b]->objectName().toStdString();
                }
            }
        }
    }
    void expectMnemonicsUnique() {
        QSet<QString> seen;
        for (const auto* button : m_page->findChildren<QAbstractButton*>()) {
            const QKeySequence key = QKeySequence::mnemonic(button->text());
            if (key.isEmpty()) continue;
            EXPECT_FALSE(seen.contains(key.toString())) << key.toString().toStdString();
            seen.insert(key.toString());
        }
    }
    /// Whatever can have the focus has a text, a name or a label that names it.
    void expectEverythingNamed() {
        for (const QWidget* widget : m_page->findChildren<QWidget*>()) {
            if (widget->focusPolicy() == Qt::NoFocus || widget->objectName().startsWith(QLatin1String("qt_"))) continue;
            const auto* button = qobject_cast<const QAbstractButton*>(widget);
            const auto* label = qobject_cast<const QLabel*>(widget);
            bool named = !widget->accessibleName().isEmpty() || (button && !button->text().isEmpty()) ||
                         (label && !label->text().isEmpty());
            for (const auto* buddy : m_page->findChildren<QLabel*>()) {
                named = named || (buddy->buddy() == widget && !buddy->text().isEmpty());
            }
            EXPECT_TRUE(named) << widget->metaObject()->className() << " " << widget->objectName().toStdString();
        }
    }

    Programme m_programme;
    std::unique_ptr<QWidget> m_page;
};

TEST_P(PageLayout, TheRdsPageIsTidy) {
    show<RdsPage>("rds");
    expectTidy();
}

TEST_P(PageLayout, TheTabKeyWalksTheRdsPageFromThePsToTheRadiotext) {
    show<RdsPage>("rds");
    const Lines expected = {"PS_T",          "PS_Taste",       "PI_T",      "Command3",     "PTY_Combo1",
                            "Taste_PS_Auto", "PS_dyn_Check",   "Check1",    "TA_EON_Hilfe", "TA_Option_0",
                            "TA_HScroll",    "TA_Rep_HScroll", "MS_opt_0",  "Zeit_Taste",   "Uhr_Zeit",
                            "DI_Opt_1",      "RT_Text1",       "RT_Taste1", "RT_clear1"};
    click("MS_opt_0");
    click("DI_Opt_1");
    root().activateWindow();
    find("PS_T")->setFocus();
    Lines walked;
    for (std::size_t i = 0; i < expected.size(); ++i) {
        walked.push_back(QApplication::focusWidget()->objectName().toStdString());
        press(walked.back().c_str(), Qt::Key_Tab);
    }
    EXPECT_EQ(walked, expected);
}

TEST_P(PageLayout, TheQueryPageIsTidy) {
    show<QueryPage>("fragen");
    expectTidy();
}

TEST_P(PageLayout, TheQueryPageShowsTheLongestAnswersWhole) {
    show<QueryPage>("fragen");
    for (int i = 0; i < 9; ++i) visa.answers.push_back("\"" + std::string(57, i < 4 ? 'x' : '8') + "\"\n");
    click("Command19");
    QApplication::processEvents();
    savePicture("fragen_eon");
    const auto* shown = find<QLabel>("gelesen");
    EXPECT_LE(shown->heightForWidth(shown->width()), shown->height());
    EXPECT_EQ(root().size(), kPageSize);
}

TEST_P(PageLayout, TheStorePageIsTidy) {
    show<StorePage>("speichern");
    expectTidy();
}

std::string languageName(const ::testing::TestParamInfo<const char*>& info) {
    std::string name = info.param;
    std::erase(name, ' ');
    return name;
}

INSTANTIATE_TEST_SUITE_P(Languages, PageLayout, ::testing::Values("deutsch", "english", "english US"), languageName);

}  // namespace
}  // namespace kdx::test
