#pragma once

#include <QLocale>
#include <QString>
#include <QStringDecoder>

#include <string>
#include <string_view>

#include "base/codepage.h"
#include "base/printable.h"
#include "settings/withoutcontrols.h"

namespace kdx {

/// 8-bit Windows-1252 text as the window shows it.
[[nodiscard]] inline QString toText(std::string_view bytes) {
    QString text(static_cast<qsizetype>(bytes.size()), Qt::Uninitialized);
    qsizetype at = 0;
    for (const char byte : bytes) text[at++] = QChar(fromCodePage(static_cast<unsigned char>(byte)));
    return text;
}

/// Whether the character is a control character of ASCII.
[[nodiscard]] inline bool isControl(QChar c) {
    return c < QChar(0x80) && isControl(c.toLatin1());
}

/// An entered text as it can be sent and kept in one line: control characters become blanks, CR LF a single one; those
/// at either end are left out. Blanks stay as typed.
[[nodiscard]] inline QString withoutControls(QStringView text) {
    QStringDecoder read(QStringDecoder::Utf8, QStringDecoder::Flag::ConvertInitialBom);  // one that begins it stays
    return read(QByteArray::fromStdString(withoutControls(text.toUtf8().toStdString())));
}

/// A text as a title shows it: each control character as a blank.
[[nodiscard]] inline QString withBlanks(QString text) {
    for (QChar& c : text) {
        if (isControl(c)) c = QLatin1Char(' ');
    }
    return text;
}

/// The window's text as 8-bit Windows-1252; a character the code page does not have becomes '?', one a character.
[[nodiscard]] inline std::string toBytes(const QString& text) {
    std::string bytes;
    bytes.reserve(static_cast<std::size_t>(text.size()));
    for (qsizetype at = 0; at < text.size(); ++at) {
        bytes.push_back(toCodePage(text[at].unicode()));
        if (text[at].isHighSurrogate() && at + 1 < text.size() && text[at + 1].isLowSurrogate()) ++at;
    }
    return bytes;
}

/// How a text in that language ("deutsch", "english", "english US") writes numbers.
[[nodiscard]] inline QLocale numberLocale(std::string_view language) {
    return QLocale(language == "deutsch" ? QLocale::German : QLocale::English);
}

}  // namespace kdx
