#pragma once

#include <chrono>
#include <cstddef>
#include <filesystem>
#include <optional>
#include <span>

namespace kdx {

// What the programs ask of the operating system.

/// The folder of the program file. @param program the program's name as it was called, where nothing better is known.
[[nodiscard]] std::filesystem::path programFolder(const char* program);

/// The user's folder for this program's data: XDG_DATA_HOME or ~/.local/share (XDG base directory standard), %APPDATA%
/// on Windows; empty when none of them names an absolute folder.
[[nodiscard]] std::filesystem::path userFolder();

/// Whether a window can be shown.
[[nodiscard]] bool hasDisplay();

/// Whether the standard error, the standard input, the standard output is a terminal.
[[nodiscard]] bool errorIsTerminal();
[[nodiscard]] bool inputIsTerminal();
[[nodiscard]] bool outputIsTerminal();

/// Whether the descriptor can be read without waiting; false for -1.
[[nodiscard]] bool isReadable(int descriptor);

/// Waits until the descriptor can be read, or the time is over; for -1 until the time is over.
void waitReadable(int descriptor, std::chrono::milliseconds time);

/// Reads what the standard input has, waiting for it. @returns how many bytes, 0 at its end; nothing when the other
/// descriptor can be read before. @throws std::system_error when the input cannot be read.
[[nodiscard]] std::optional<std::size_t> readInput(std::span<char> room, int unless);

/// From now on writing to a pipe that nobody reads any more fails, instead of ending the program.
void surviveBrokenPipes();

/// From now on the system's requests to end the program (SIGTERM, SIGINT, SIGHUP; on Windows Ctrl+C, Ctrl+Break and the
/// closing of the console) no longer end it at once: they make the descriptor that this gives readable, for the calls
/// here. -1 when they cannot be had so: to a program with windows on Windows nobody says it, and what is broken off at
/// the console that it was started from does not concern it.
[[nodiscard]] int endRequests();

/// Opens what of standard input, output and error the caller has closed: else the next file opened would take its place
/// and get what is printed. Writing to such an output fails still.
void openStandardStreams();

/// Where a program with windows begins without the terminal that it was started from, it gets it back to print to, and
/// terminals take texts as UTF-8; where all that is so anyway, nothing happens.
void useTerminal();

/// A program with windows goes on without that terminal: closing it ends nothing. Nothing can be printed any more
/// there; elsewhere nothing happens.
void leaveTerminal();

/// Whether something that was printed is lost, and not since its reader has gone away.
[[nodiscard]] bool outputIsLost();

/// What the standard input has of a line.
enum class InputLine { NotYet, Whole, Ended };
/// Takes a line off the standard input when there is one, without waiting for it.
[[nodiscard]] InputLine takeInputLine();

/// Throws away what was typed at a terminal and not taken yet; what comes from elsewhere stays.
void forgetTypedInput();

}  // namespace kdx
