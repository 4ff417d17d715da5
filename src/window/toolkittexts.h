#pragma once

#include <QTranslator>

namespace kdx {

class Captions;

/// The words of the window toolkit itself in the language of the window: its menus at a click with the right button,
/// its file boxes, the keys behind entries of menus. It comes without translations, and with any it would speak the
/// language of the desktop, as kinds and times of files in these boxes do. A text that the language file has not stays
/// as it is.
class ToolkitTexts : public QTranslator {
public:
    explicit ToolkitTexts(const Captions& captions) : m_captions(captions) {}

    [[nodiscard]] bool isEmpty() const override { return false; }
    QString translate(const char* context, const char* text, const char* hint, int count) const override;

private:
    const Captions& m_captions;
};

}  // namespace kdx
