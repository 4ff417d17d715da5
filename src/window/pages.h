#pragma once

#include <vector>

#include "ui/pagecontext.h"

namespace kdx {

class HMenue;
class Page;
struct Station;

/// Makes the window's pages in the order of their tabs, each with its part of the data set, and wires what one of them
/// causes outside itself.
[[nodiscard]] std::vector<Page*> makePages(const PageContext& with, Station& station, HMenue& window);

}  // namespace kdx
