#pragma once

#include <filesystem>

namespace kdx {

// What the programs ask of the operating system.

/// The folder of the program file. @param program the program's name as it was called, where nothing better is known.
[[nodiscard]] std::filesystem::path programFolder(const char* program);

/// The user's folder for this program's data: XDG_DATA_HOME or ~/.local/share (XDG base directory standard), %APPDATA%
/// on Windows; empty when none of them names an absolute folder.
[[nodiscard]] std::filesystem::path userFolder();

/// Whether a window can be shown.
[[nodiscard]] bool hasDisplay();

/// Whether the standard error is a terminal.
[[nodiscard]] bool errorIsTerminal();

/// Whether the descriptor can be read without waiting; false for -1.
[[nodiscard]] bool isReadable(int descriptor);

/// From now on writing to a pipe that nobody reads any more fails, instead of ending the program.
void surviveBrokenPipes();

/// From now on the system's requests to end the program (SIGTERM, SIGINT, SIGHUP) no longer end it at once: they make
/// the descriptor that this gives readable. -1 when they cannot be had so.
[[nodiscard]] int endRequests();

}  // namespace kdx
