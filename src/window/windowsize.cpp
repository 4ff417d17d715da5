#include "window/windowsize.h"

#include <QFontInfo>
#include <QMainWindow>

#include "window/pagetabs.h"

namespace kdx {

namespace {

constexpr QSize kDesignSize{640, 480};  // pixels at 96 dpi
constexpr int kDesignFont = 11;         // pixels: 8.25 points

}  // namespace

void fitToFont(QMainWindow& window, PageTabs& pages) {
    const int font = QFontInfo(window.font()).pixelSize();
    const bool asDesigned = font <= kDesignFont;
    pages.askPages(!asDesigned);
    // Stated where it can be, not left to the layouts: they would still know sizes from before captions were set and
    // parts hidden. Unstated, it is what the layouts need, as that changes.
    window.setMinimumSize(asDesigned ? kDesignSize : QSize(0, 0));
    window.resize(asDesigned ? kDesignSize : kDesignSize * font / kDesignFont);
}

}  // namespace kdx
