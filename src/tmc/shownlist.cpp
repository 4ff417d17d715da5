#include "tmc/shownlist.h"

#include "settings/datafolder.h"
#include "tmc/tmclist.h"
#include "ui/caption.h"
#include "ui/text.h"

#include <stdexcept>
#include <string>
#include <string_view>

namespace kdx {

namespace {

// No entry is that long; a file of garbage must not keep the window laying out a line of a megabyte.
constexpr std::size_t kLongestShown = 1000;

}  // namespace

QStringList loadShownList(const PageContext& with, const char* fileName) {
    const auto entries = loadTmcList(with.data.file(fileName));
    if (!entries) {
        const QString text = captionText(with.captions, {593, "%1 kann nicht gelesen werden."});
        throw std::runtime_error(text.arg(QLatin1String(fileName)).toStdString());
    }
    QStringList shown;
    for (const std::string& entry : *entries) shown << toText(std::string_view(entry).substr(0, kLongestShown));
    return shown;
}

QFont fixedPitch(const QString& family) {
    QFont font;
    font.setFamilies({family, QStringLiteral("Liberation Mono"), QStringLiteral("DejaVu Sans Mono")});
    font.setStyleHint(QFont::TypeWriter);
    font.setFixedPitch(true);
    return font;
}

void takeAllSteps(std::initializer_list<std::function<void()>> steps) {
    std::string failures;
    for (const auto& step : steps) {
        try {
            step();
        } catch (const std::exception& error) {
            if (!failures.empty()) failures += '\n';
            failures += error.what();
        }
    }
    if (!failures.empty()) throw std::runtime_error(failures);
}

}  // namespace kdx
