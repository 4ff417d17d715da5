// What an entry says of itself in its own box.
#include "ui/sententry.h"

#include <gtest/gtest.h>

#include "support/pagetest.h"

namespace kdx::test {
namespace {

class SentEntryTest : public PageTest {
protected:
    QWidget& root() override { return entry; }
    /// How many points in the right half bear the colour of the note.
    int noted(int width) {
        entry.resize(width, entry.sizeHint().height());
        const QImage picture = entry.grab().toImage();
        int count = 0;
        for (int y = 0; y < picture.height(); ++y) {
            for (int x = picture.width() / 2; x < picture.width(); ++x) {
                const QColor point = picture.pixelColor(x, y);
                if (point.red() - point.blue() > 90 && point.red() < 0xC0) ++count;  // neither ground nor letters
            }
        }
        return count;
    }
    bool isUnsent() { return entry.property("zustand") == QStringLiteral("ungesendet"); }

    static constexpr int kWide = 400;  // room for a name and the note
    SentEntry entry{context, "RT", nullptr};
};

TEST_F(SentEntryTest, ATypedValueSaysInItsBoxThatItIsNotSentYet) {
    entry.setText(QStringLiteral("RADIO"));
    EXPECT_TRUE(isUnsent());
    EXPECT_GT(noted(kWide), 20);
    entry.wentOut("RADIO");
    EXPECT_FALSE(isUnsent());
    EXPECT_EQ(noted(kWide), 0);
    entry.setText(QStringLiteral("RADIO 2"));
    EXPECT_GT(noted(kWide), 20);
}

TEST_F(SentEntryTest, TheNoteIsInTheLanguageOfTheWindow) {
    entry.setText(QStringLiteral("RADIO"));
    (void)noted(kWide);
    const QImage german = entry.grab().toImage();
    useLanguage("english");
    EXPECT_NE(entry.grab().toImage(), german);
}

TEST_F(SentEntryTest, ABoxThatCannotBeUsedSaysNothing) {
    entry.setText(QStringLiteral("RADIO"));
    entry.setEnabled(false);
    EXPECT_EQ(noted(kWide), 0);
}

TEST_F(SentEntryTest, WhereTheTextTakesTheRoomColourAndTipTellItAlone) {
    const QString longText(61, QLatin1Char('M'));
    entry.setText(longText);
    EXPECT_EQ(noted(kWide), 0) << "the note would stand across the text";
    EXPECT_TRUE(isUnsent());
    EXPECT_EQ(entry.palette().color(QPalette::Base), QColor(0xFF, 0xF8, 0xD0));
    EXPECT_FALSE(entry.toolTip().isEmpty());
    EXPECT_GT(noted(entry.fontMetrics().horizontalAdvance(longText) + kWide), 20) << "there is room again";
}

}  // namespace
}  // namespace kdx::test
