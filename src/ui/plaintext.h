#pragma once

class QObject;
class QWidget;

namespace kdx {

/// Name of the property with which a window says that double quotes in its entries go out doubled.
inline constexpr const char* kQuotesDoubled = "quotesDoubled";

/// To be called for each control before it is first shown. What labels and tool tips show is text and never markup: a
/// caption or an answer of the instrument must not make the program fetch a picture. What is typed or pasted into an
/// entry loses its control characters: line ends copied along would end the command or the line of the file.
void keepTextPlain(QObject& control);

/// Marks the entries with a double quote anew, when kQuotesDoubled was changed.
void markQuotes(const QWidget& window);

}  // namespace kdx
