#include "ui/valuestate.h"

#include <QAbstractButton>
#include <QComboBox>
#include <QLabel>
#include <QPalette>
#include <QPushButton>
#include <QScrollBar>
#include <QVariant>
#include <QWidget>

#include <string_view>

#include "coder/fieldsizes.h"
#include "coder/keyfacts.h"
#include "coder/rdscharacters.h"
#include "settings/programstate.h"
#include "ui/caption.h"
#include "ui/pagecontext.h"
#include "ui/text.h"

namespace kdx {

namespace {

// What the tip was made of: whoever captions the control anew replaces the tip, and that is its own from then on.
constexpr const char* kOwnTip = "ownTip";
constexpr const char* kStateTip = "stateTip";
constexpr const char* kShownTip = "shownTip";

const char* nameOf(ValueState state) {
    switch (state) {
        case ValueState::Unsent:
            return "ungesendet";
        case ValueState::Refused:
            return "abgelehnt";
        case ValueState::InForce:
            break;
    }
    return "";
}

struct Roles {
    QPalette::ColorRole letters, ground;
    bool onParent = false;  ///< has no ground of its own as long as it is in force
};

Roles rolesOf(const QWidget& control) {
    if (qobject_cast<const QLabel*>(&control) != nullptr) return {QPalette::WindowText, QPalette::Window};
    if (qobject_cast<const QAbstractButton*>(&control) != nullptr)
        return {QPalette::ButtonText, QPalette::Button, qobject_cast<const QPushButton*>(&control) == nullptr};
    if (qobject_cast<const QComboBox*>(&control) != nullptr || qobject_cast<const QScrollBar*>(&control) != nullptr)
        return {QPalette::ButtonText, QPalette::Button};
    return {QPalette::Text, QPalette::Base};
}

/// Text and ground together, so that they go with each other whatever the theme. Controls that cannot be used keep the
/// look of those.
void colour(QWidget& control, ValueState state) {
    QPalette palette;
    palette.setResolveMask(0);  // nothing of its own: what it has from its parents
    const bool label = qobject_cast<QLabel*>(&control) != nullptr;
    const Roles roles = rolesOf(control);
    if (state == ValueState::Unsent && label) {
        const QColor grey = palette.color(QPalette::Disabled, QPalette::WindowText);
        palette.setColor(QPalette::WindowText, grey);
    } else if (state != ValueState::InForce) {
        const bool refused = state == ValueState::Refused;
        const QColor letters = refused ? QColor(Qt::red) : QColor(Qt::black);
        const QColor ground = refused ? QColor(0xFF, 0xF4, 0xF2) : QColor(0xFF, 0xF8, 0xD0);
        for (const auto group : {QPalette::Active, QPalette::Inactive}) {
            palette.setColor(group, roles.letters, letters);
            if (roles.onParent) palette.setColor(group, QPalette::WindowText, letters);  // beside an indicator
            palette.setColor(group, roles.ground, ground);
        }
    }
    if (roles.onParent) control.setAutoFillBackground(state != ValueState::InForce);
    control.setPalette(palette);
}

bool isMade(const QWidget& control) {
    return control.toolTip() == control.property(kShownTip).toString();
}

void showTips(QWidget& control, const QString& state, const QString& own) {
    const QString shown = state.isEmpty() || own.isEmpty() ? state + own : state + QLatin1Char('\n') + own;
    control.setProperty(kOwnTip, own);
    control.setProperty(kStateTip, state);
    control.setProperty(kShownTip, shown);
    control.setToolTip(shown);
}

bool isCarriedText(std::string_view key) {
    return key == "PS" || key == "EON_PS" || key == "RT";
}

}  // namespace

QString ownTip(const QWidget& control) {
    const QString shown = control.toolTip();
    return !shown.isEmpty() && isMade(control) ? control.property(kOwnTip).toString() : shown;
}

void setOwnTip(QWidget& control, const QString& tip) {
    const bool hasState = !control.toolTip().isEmpty() && isMade(control);
    const QString state = hasState ? control.property(kStateTip).toString() : QString();
    if (state.isEmpty()) return control.setToolTip(tip);  // most controls never have a state
    showTips(control, state, tip);
}

void showState(QWidget& control, ValueState state, const QString& tip) {
    showTips(control, tip, ownTip(control));
    control.setAccessibleDescription(tip);
    control.setProperty("zustand", QString::fromLatin1(nameOf(state)));
    colour(control, state);
    control.update();
}

void showJudgement(QWidget& control, const Judgement& judgement) {
    if (judgement.state == ValueState::InForce && !control.property("zustand").isValid()) return;
    showState(control, judgement.state, judgement.tip);
}

void showWarning(QWidget& control, const QString& tip) {
    showState(control, tip.isEmpty() ? ValueState::InForce : ValueState::Refused, tip);
}

QString whyRefused(const PageContext& with, const char* key, const QString& entry) {
    return whyRefused(with, key, entry, with.state.corrections);
}

QString whyRefused(const PageContext& with, const char* key, const QString& entry, const Corrections& corrections) {
    const auto say = [&](const Caption& caption) { return captionText(with.captions, caption); };
    const std::string_view name = key;
    const std::string bytes = toBytes(entry);
    if (isCarriedText(name)) {
        const QString kept = toText(bytes);  // what the code page lacks has become a question mark
        for (qsizetype at = 0; at < entry.size() && at < kept.size(); ++at) {
            if (kept[at] != entry[at]) return say({852, "RDS kennt das Zeichen %1 nicht."}).arg(entry[at]);
        }
    }
    if (!wrongValue(name, bytes, corrections)) return {};
    if (name == "PI" || name == "EON_PI") return say({850, "Die PI muss aus vier hexadezimalen Ziffern bestehen."});
    if (isCarriedText(name)) {
        if (!corrections.quotes && entry.contains(QLatin1Char('"')))
            return say({851, "Ein Anführungszeichen beendet den Text für den Coder."});
        if (const auto missing = withoutRdsCode(bytes))
            return say({852, "RDS kennt das Zeichen %1 nicht."}).arg(toText({&*missing, 1}));
        return say({853, "Höchstens %1 Zeichen."}).arg(name == "RT" ? kRadiotextLength : kPsLength);
    }
    const KeyFacts* const facts = factsOf(name);
    if (facts != nullptr && facts->isNumber && entry.contains(QLatin1Char(',')))
        return say({854, "Der Coder nimmt nur einen Punkt, kein Komma."});
    return say({855, "Der Coder nimmt diesen Wert nicht an."});
}

}  // namespace kdx
