#pragma once

#include <QString>

#include <chrono>
#include <filesystem>
#include <functional>
#include <vector>

namespace kdx {

class Captions;
class Clock;
class DataFolder;
class Dialogs;
class FolderClaim;
struct ProgramState;
struct Session;
class TickerGroup;
class WorkerVisa;

/// What the window works with; everything is borrowed and outlives it.
struct Surroundings {
    Session& session;
    ProgramState& state;
    DataFolder& data;
    Captions& captions;
    Clock& clock;
    Dialogs& dialogs;
    TickerGroup& tickers;
    const FolderClaim& claim;          ///< on the data folder
    QString linkDescription;           ///< how instruments are reached, for the about box
    QString dataProblem;               ///< what is wrong with the data folder, in words; usually nothing
    std::function<void()> endProgram;  ///< ends the program at once
    WorkerVisa* worker = nullptr;      ///< the session's link, where the calls to it run in a thread of their own
    std::chrono::milliseconds answerTime{2000};  ///< how long an instrument may take for an answer
    bool simulated = false;                      ///< the instrument is the virtual one inside the program
    std::filesystem::path shipped{};             ///< the program's folder as it was shipped; none where it is not known
    std::filesystem::path placeFile{};           ///< keeps the window's page and place; none: they are not kept
    std::vector<std::filesystem::path> keptFiles{};  ///< shipped files in whose places the user's own changed ones stay
};

}  // namespace kdx
