#pragma once

#include <string_view>

class QLabel;
class QListWidget;

namespace kdx {

/// Shows a list text (8-bit): the tuned frequency in the label, the alternative frequencies in the list box, one a row.
/// A text without a comma changes nothing: a list with a tuned frequency only is not shown, and neither is an empty
/// one, so that what was shown before stays.
void FillAfLists(QListWidget& list, QLabel& tuned, std::string_view listText);

}  // namespace kdx
