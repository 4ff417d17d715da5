#pragma once

#include <gtest/gtest.h>

#include <QString>

#include <deque>
#include <string>
#include <vector>

#include "ui/dialogs.h"

namespace kdx::test {

/// Boxes that answer in turn; a box nobody expected fails the test.
class ScriptedDialogs final : public Dialogs {
public:
    struct Shown {
        Icon icon = Icon::None;
        QString title;
        QString text;
        QString preset;           ///< of an input box; of a message box the details
        QString aboutDetails;     ///< of the about box, shown when the user opens them
        bool offersStop = false;  ///< has a second button that stops the running sequence
        QString stop = {};        ///< its caption where it is another one
    };

    void message(Icon icon, const QString& title, const QString& text, const QString& details = {}) override {
        shown.push_back({icon, title, text, details, {}, false});
        if (expectedMessages > 0) {
            --expectedMessages;
        } else {
            ADD_FAILURE() << "unexpected box: " << title.toStdString() << " | " << text.toStdString();
        }
    }
    void about(const QString& text, const QString& madeOf, const QString& details) override {
        message(Icon::Exclamation, {}, text, madeOf);
        shown.back().aboutDetails = details;
    }
    bool messageOrStop(const QString& title, const QString& text, const QString& details = {}, const QString& stop = {},
                       Icon icon = Icon::Critical) override {
        message(icon, title, text, details);
        shown.back().offersStop = true;
        shown.back().stop = stop;
        return stopAtFailure;
    }
    bool confirm(const QString& title, const QString& text) override {
        shown.push_back({Icon::None, title, text, {}, {}, false});
        if (confirmations.empty()) {
            ADD_FAILURE() << "unexpected question: " << text.toStdString();
            return false;
        }
        const bool answer = confirmations.front();
        confirmations.pop_front();
        return answer;
    }
    QString input(const QString& prompt, const QString& title, const QString& preset) override {
        shown.push_back({Icon::None, title, prompt, preset, {}, false});
        if (inputs.empty()) {
            ADD_FAILURE() << "unexpected input box: " << prompt.toStdString();
            return {};
        }
        QString answer = inputs.front();
        inputs.pop_front();
        return answer;
    }

    QString fileToSave(const QString& title, const QString& preset, const QString& kind) override {
        shown.push_back({Icon::None, title, kind, preset, {}, false});
        if (files.empty()) {
            ADD_FAILURE() << "unexpected box for a file: " << title.toStdString();
            return {};
        }
        QString file = files.front();
        files.pop_front();
        return file;
    }

    QString fileToOpen(const QString& title, const QString& kind, const QString& folder = {}) override {
        return fileToSave(title, folder, kind);
    }
    [[nodiscard]] bool canAsk() const override { return !ending; }

    ~ScriptedDialogs() override {
        EXPECT_EQ(expectedMessages, 0) << "a box that was expected did not show";
        EXPECT_TRUE(inputs.empty()) << "an input box that was expected did not show";
        EXPECT_TRUE(files.empty()) << "a box for a file that was expected did not show";
        EXPECT_TRUE(confirmations.empty()) << "a question that was expected was not asked";
    }

    int expectedMessages = 0;        ///< how many message boxes may still come
    bool stopAtFailure = false;      ///< press the button that stops the running sequence
    std::deque<QString> inputs;      ///< answers of the input boxes, in turn; empty for Cancel
    std::deque<QString> files;       ///< answers of the boxes for a file, in turn; empty for Cancel
    bool ending = false;             ///< the program is, and nobody is there to answer
    std::deque<bool> confirmations;  ///< answers of the Yes/No boxes, in turn
    std::vector<Shown> shown;        ///< every box, in order
};

}  // namespace kdx::test
