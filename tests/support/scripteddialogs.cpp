#include "support/scripteddialogs.h"

#include <gtest/gtest.h>

namespace kdx::test {

ScriptedDialogs::~ScriptedDialogs() {
    EXPECT_EQ(expectedMessages, 0) << "a box that was expected did not show";
    EXPECT_TRUE(inputs.empty()) << "an input box that was expected did not show";
    EXPECT_TRUE(files.empty()) << "a box for a file that was expected did not show";
    EXPECT_TRUE(confirmations.empty()) << "a question that was expected was not asked";
}

void ScriptedDialogs::message(Icon icon, const QString& title, const QString& text, const QString& details) {
    shown.push_back({icon, title, text, details, {}, false});
    if (expectedMessages > 0) {
        --expectedMessages;
    } else {
        ADD_FAILURE() << "unexpected box: " << title.toStdString() << " | " << text.toStdString();
    }
}

void ScriptedDialogs::about(const QString& text, const QString& madeOf, const QString& details) {
    message(Icon::Exclamation, {}, text, madeOf);
    shown.back().aboutDetails = details;
}

bool ScriptedDialogs::messageOrStop(const QString& title, const QString& text, const QString& details,
                                    const QString& stop, Icon icon) {
    message(icon, title, text, details);
    shown.back().offersStop = true;
    shown.back().stop = stop;
    return stopAtFailure;
}

bool ScriptedDialogs::confirm(const QString& title, const QString& text) {
    shown.push_back({Icon::None, title, text, {}, {}, false});
    if (confirmations.empty()) {
        ADD_FAILURE() << "unexpected question: " << text.toStdString();
        return false;
    }
    const bool answer = confirmations.front();
    confirmations.pop_front();
    return answer;
}

QString ScriptedDialogs::input(const QString& prompt, const QString& title, const QString& preset) {
    shown.push_back({Icon::None, title, prompt, preset, {}, false});
    if (inputs.empty()) {
        ADD_FAILURE() << "unexpected input box: " << prompt.toStdString();
        return {};
    }
    QString answer = inputs.front();
    inputs.pop_front();
    return answer;
}

QString ScriptedDialogs::fileToSave(const QString& title, const QString& preset, const QString& kind) {
    shown.push_back({Icon::None, title, kind, preset, {}, false});
    if (files.empty()) {
        ADD_FAILURE() << "unexpected box for a file: " << title.toStdString();
        return {};
    }
    QString file = files.front();
    files.pop_front();
    return file;
}

QString ScriptedDialogs::fileToOpen(const QString& title, const QString& kind, const QString& folder) {
    return fileToSave(title, folder, kind);
}

}  // namespace kdx::test
