#pragma once

#include <QString>

#include <filesystem>
#include <functional>
#include <string>

#include "ui/dialogs.h"

class QPixmap;

namespace kdx {

class HMenue;
class Instrument;

/// Boxes during the tour: nobody is there to close them, so each one is printed and counts as a failure.
class TourDialogs final : public Dialogs {
public:
    explicit TourDialogs(std::function<void(const std::string& line)> print);

    void message(Icon icon, const QString& title, const QString& text, const QString& details = {}) override;
    bool messageOrStop(const QString& title, const QString& text, const QString& details, const QString& stop,
                       Icon icon) override;
    bool confirm(const QString& title, const QString& text) override;
    QString input(const QString& prompt, const QString& title, const QString& preset) override;
    QString fileToSave(const QString& title, const QString& preset, const QString& kind) override;
    QString fileToOpen(const QString& title, const QString& kind, const QString& folder) override;

    /// Which file is chosen from now on where one is asked for.
    void chooseToOpen(const std::filesystem::path& file) { m_toOpen = file; }
    [[nodiscard]] int count() const { return m_count; }

private:
    void note(const QString& title, const QString& text);

    std::function<void(const std::string&)> m_print;
    std::filesystem::path m_toOpen;
    int m_count = 0;
};

/// Saves as PNG, to a plain file only: what is behind a link is not the tour's to overwrite, and nobody may be reading
/// a pipe.
[[nodiscard]] bool savePicture(const QPixmap& picture, const std::filesystem::path& file);

/// Walks through the whole window as a user does: opens the session (which sends the data set), shows each page and
/// saves a picture of it, presses every read-back button, and prints everything that passed.
/// @returns 0 when the session opened, every picture was saved, every question was answered and no box showed.
[[nodiscard]] int makeTour(HMenue& window, Instrument& instrument, const TourDialogs& dialogs,
                           const std::filesystem::path& folder,
                           const std::function<void(const std::string& line)>& print);

}  // namespace kdx
