#pragma once

#include <QTranslator>

namespace kdx {

class Captions;

/// Names the keys of the menus as they stand on the keyboard of the language: the toolkit comes without translations.
class KeyNames : public QTranslator {
public:
    explicit KeyNames(const Captions& captions) : m_captions(captions) {}

    [[nodiscard]] bool isEmpty() const override { return false; }
    QString translate(const char* context, const char* text, const char* hint, int count) const override;

private:
    const Captions& m_captions;
};

}  // namespace kdx
