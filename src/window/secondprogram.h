#pragma once

namespace kdx {

class Captions;
class DataFolder;
class Dialogs;
class FolderClaim;

/// Asks, when another program uses the data folder already, whether to go on with data that are only read: two that
/// write would take each other's settings away, and the second one's start the first one's log.
/// @returns false when this program is to end.
[[nodiscard]] bool goesOnBesideAnother(const FolderClaim& claim, DataFolder& data, Captions& captions,
                                       Dialogs& dialogs);

}  // namespace kdx
