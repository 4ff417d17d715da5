#include "window/keynames.h"

#include <string_view>

#include "ui/caption.h"

namespace kdx {

QString KeyNames::translate(const char* context, const char* text, const char* /*hint*/, int /*count*/) const {
    if (context == nullptr || text == nullptr || std::string_view(context) != "QShortcut") return {};
    const std::string_view key = text;
    if (key == "Ctrl") return captionText(m_captions, {1257, "Strg"});
    if (key == "Shift") return captionText(m_captions, {1258, "Umschalt"});
    return {};
}

}  // namespace kdx
