#pragma once

#include <QApplication>
#include <QFont>

#include <string>

#include "support/layoutcheck.h"

namespace kdx::test {

/// The languages and the sizes of letters, in points, that every window has to bear.
inline constexpr const char* kEveryLanguage[] = {"deutsch", "english", "english US"};
inline constexpr int kEveryFontSize[] = {8, 10, 12};

/// The desktop's font in another size, until this goes.
class FontSize {
public:
    explicit FontSize(int points) {
        QFont font = m_before;
        font.setPointSize(points);
        QApplication::setFont(font);
    }
    ~FontSize() { QApplication::setFont(m_before); }
    FontSize(const FontSize&) = delete;
    FontSize& operator=(const FontSize&) = delete;

private:
    QFont m_before = QApplication::font();
};

/// Shows a window in every language at every size of letters: as it opens, and as small as it becomes, nothing of it
/// may be cut off. @param open makes and shows it in the language, filled with what needs the most room.
template <typename Open>
void expectNothingCutOffAnywhere(Open open) {
    for (const int points : kEveryFontSize) {
        const FontSize font(points);
        for (const char* language : kEveryLanguage) {
            QWidget& window = open(language);
            const std::string where = std::string(language) + ", " + std::to_string(points) + " points";
            QCoreApplication::processEvents();
            expectNothingCutOff(window, where);
            window.resize(1, 1);
            QCoreApplication::processEvents();
            expectNothingCutOff(window, where + ", smallest");
        }
    }
}

}  // namespace kdx::test
