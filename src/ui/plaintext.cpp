#include "ui/plaintext.h"

#include "ui/text.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QValidator>

#include <algorithm>

namespace kdx {

namespace {

/// Takes the control characters out of whatever comes into an entry, and accepts the rest.
class ControlRemover final : public QValidator {
public:
    using QValidator::QValidator;

    State validate(QString& input, int& position) const override {
        // A letter in the cursor's place: what stands before it is not the end of the text.
        const auto before = withoutControls(QString(input.left(position) + QLatin1Char('x'))).size() - 1;
        input = withoutControls(input);
        position = static_cast<int>(std::min(before, input.size()));
        return Acceptable;
    }
};

/// Shows the text in red while it has a double quote in it, which would end it for the coder unless it goes out
/// doubled.
void markQuote(QLineEdit& entry) {
    QPalette palette = entry.palette();
    const bool quoted = entry.text().contains(QLatin1Char('"')) && !entry.window()->property(kQuotesDoubled).toBool();
    const QPalette usual = QApplication::palette(&entry);
    // One that cannot be used looks so still, but a quote is to be seen before the session that would send it.
    for (const auto group : {QPalette::Active, QPalette::Inactive, QPalette::Disabled})
        palette.setColor(group, QPalette::Text, quoted ? QColor(Qt::red) : usual.color(group, QPalette::Text));
    entry.setPalette(palette);
}

}  // namespace

void keepTextPlain(QObject& control) {
    if (auto* label = qobject_cast<QLabel*>(&control)) {
        label->setTextFormat(Qt::PlainText);  // the tool tip is one too
    } else if (auto* entry = qobject_cast<QLineEdit*>(&control); entry != nullptr && entry->validator() == nullptr) {
        entry->setValidator(new ControlRemover(entry));
        QObject::connect(entry, &QLineEdit::textChanged, entry, [entry] { markQuote(*entry); });
        if (entry->text().contains(QLatin1Char('"'))) markQuote(*entry);
    }
}

void markQuotes(const QWidget& window) {
    for (QLineEdit* entry : window.findChildren<QLineEdit*>()) markQuote(*entry);
}

}  // namespace kdx
