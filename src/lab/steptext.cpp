#include "lab/steptext.h"

#include "settings/programstate.h"
#include "ui/caption.h"
#include "ui/text.h"

namespace kdx {

namespace {

std::string timeWords(const PageContext& with, std::chrono::milliseconds time) {
    if (time < std::chrono::seconds(1)) return std::to_string(time.count()) + " ms";
    const double seconds = static_cast<double>(time.count()) / 1000;
    return numberLocale(with.state.language).toString(seconds, 'g', QLocale::FloatingPointShortest).toStdString() +
           " s";
}

}  // namespace

QString stepText(const PageContext& with, const scenario::Action& action) {
    using Kind = scenario::Action::Kind;
    const auto say = [&](const Caption& caption, const std::vector<std::string>& words) {
        return captionText(with.captions, caption, words);
    };
    switch (action.kind) {
        case Kind::Send:
            return say({1214, "senden %1"}, {listed(action)});
        case Kind::Wait:
            return say({1215, "warten: %1"}, {timeWords(with, action.time)});
        case Kind::Expect:
            if (action.time.count() == 0) return say({1216, "erwarten %1"}, {listed(action)});
            return say({1217, "erwarten %1 innerhalb %2"}, {listed(action), timeWords(with, action.time)});
        case Kind::Sweep:
            return say({1218, "%1 von %2 bis %3, %4 Werte"},
                       {action.key, action.points.front(), action.points.back(), std::to_string(action.points.size())});
        case Kind::Repeat:
            return say({1219, "%1× wiederholen"}, {std::to_string(action.passes)});
        case Kind::TrafficMessage:
            return say({1220, "TMC senden: %1"}, {action.text});
        case Kind::Pause:
            return say({1221, "Pause: %1"}, {action.text});
        case Kind::Note:
            return say({1222, "Notiz: %1"}, {action.text});
    }
    return {};
}

QString openingText(const PageContext& with, int dataSet) {
    return captionText(with.captions, {1223, "Datensatz %1 senden"}).arg(dataSet);
}

QString restoringText(const PageContext& with) {
    return captionText(with.captions, {1224, "wiederherstellen, was vorher war"});
}

}  // namespace kdx
