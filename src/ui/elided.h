#pragma once

class QLabel;
class QString;

namespace kdx {

/// From now on a text of one line that does not fit the label ends with "…", and the label's tip begins with all of
/// it. For labels whose text may be of any length and must not widen what they stand in.
void elideLongText(QLabel& label);

/// Whether a text that does not fit the label is shown so.
[[nodiscard]] bool elidesLongText(const QLabel& label);

/// What the label shows of its text.
[[nodiscard]] QString visibleText(const QLabel& label);

}  // namespace kdx
