#pragma once

#include <span>

#include "ui/pagecontext.h"

namespace kdx {

class HMenue;
class Page;
struct Station;

/// A page as the window knows it.
struct PageRow {
    /// Makes it with its part of the data set, and wires what it causes outside itself and what is asked of it there.
    Page* (*make)(const PageContext& with, Station& station, HMenue& window);
    int tabCaption;                 ///< number of the caption of its tab
    const char* chapter;            ///< file of its chapter in the manual
    const char* afLists = nullptr;  ///< the AF editor's lists once its tab was opened; null when they stay
};

/// The window's pages in the order of their tabs.
[[nodiscard]] std::span<const PageRow> pageRows();

}  // namespace kdx
