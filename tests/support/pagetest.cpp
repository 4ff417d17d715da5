#include "support/pagetest.h"

#include <filesystem>

#include "support/sourcefolder.h"

namespace kdx::test {

PageTest::PageTest() {
    const auto languages = sourceFolder() / "Daten" / kLanguageFile;
    std::filesystem::copy_file(languages, folder.data() / kLanguageFile);
    instrument.onFailure([this](const std::string& text, bool sequenceRuns) {
        const QString title = QStringLiteral("Interface Error");
        if (sequenceRuns) return dialogs.messageOrStop(title, toText(text));
        dialogs.message(Dialogs::Icon::Critical, title, toText(text));
        return false;
    });
    state.InstrumentOnline = true;
    state.shownClock = "12:00:00";
    useLanguage("deutsch");
}

void PageTest::useLanguage(const std::string& language, const std::string& standard) {
    state.language = language;
    state.standard = standard;
    captions.load(language, standard);
}

std::string PageTest::stateOf(StatusSlot slot) const {
    const auto name = QStringLiteral("Status_%1").arg(static_cast<int>(slot));
    return statusRow.findChild<QLabel*>(name)->property("zustand").toString().toStdString();
}

void PageTest::inVain(const std::function<void()>& action) {
    visa.writeStatus = visa::kTimeout;
    dialogs.expectedMessages = 1;
    action();
    EXPECT_EQ(dialogs.expectedMessages, 0) << "nothing was sent";
    visa.writeStatus = 0;
}

}  // namespace kdx::test
