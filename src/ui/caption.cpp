#include "ui/caption.h"

#include <QAbstractButton>
#include <QGroupBox>
#include <QLabel>

#include "base/filled.h"
#include "settings/captions.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr int kFirstOwnNumber = 300;

void show(QWidget* control, const QString& text) {
    if (auto* label = qobject_cast<QLabel*>(control)) {
        label->setText(text);
    } else if (auto* button = qobject_cast<QAbstractButton*>(control)) {
        button->setText(text);
    } else if (auto* frame = qobject_cast<QGroupBox*>(control)) {
        frame->setTitle(text);
    } else {
        control->setWindowTitle(text);
    }
}

}  // namespace

QString captionText(const Captions& captions, const Caption& caption) {
    const std::string text =
        caption.number < kFirstOwnNumber ? captions.text(caption.number) : captions.own(caption.number, caption.design);
    return toText(text) + caption.after;
}

QString captionText(const Captions& captions, const Caption& caption, const std::vector<std::string>& words) {
    return QString::fromStdString(filled(captionText(captions, caption).toStdString(), words));
}

QString shownText(const QWidget* control) {
    if (const auto* label = qobject_cast<const QLabel*>(control)) return label->text();
    if (const auto* button = qobject_cast<const QAbstractButton*>(control)) return button->text();
    if (const auto* frame = qobject_cast<const QGroupBox*>(control)) return frame->title();
    return {};
}

void CaptionBook::describe(QWidget* control, const Caption& caption) {
    tip(control, caption);
    spoken(control, caption);
}

void CaptionBook::head(QLabel* heading, QWidget* control) {
    heading->setBuddy(control);
    spokenAs(control, heading);
}

void CaptionBook::label(const Captions& captions) const {
    for (const Row& row : m_rows) {
        switch (row.what) {
            case What::Text:
                show(row.control, captionText(captions, row.caption));
                break;
            case What::Tip:
                row.control->setToolTip(captionText(captions, row.caption));
                break;
            case What::Placeholder:
                row.control->setProperty("placeholderText", captionText(captions, row.caption));
                break;
            case What::Spoken:
                row.control->setAccessibleName(captionText(captions, row.caption));
                break;
            case What::SpokenAs: {
                const QString own = shownText(row.control);
                const bool button = qobject_cast<const QAbstractButton*>(row.control) != nullptr && !own.isEmpty();
                row.control->setAccessibleName(shownText(row.heading) + (button ? QLatin1Char(' ') + own : QString()));
                break;
            }
        }
    }
}

}  // namespace kdx
