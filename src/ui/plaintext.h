#pragma once

class QObject;

namespace kdx {

/// To be called for each control before it is first shown. What labels and tool tips show is text and never markup: a
/// caption or an answer of the instrument must not make the program fetch a picture.
void keepTextPlain(QObject& control);

}  // namespace kdx
