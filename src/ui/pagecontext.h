#pragma once

namespace kdx {

class Captions;
class Clock;
class DataFolder;
class Dialogs;
class Instrument;
class ParamSender;
class StatusRow;
struct ProgramState;

/// What a page works with; everything is borrowed and outlives the page.
struct PageContext {
    ParamSender& params;
    Instrument& instrument;
    ProgramState& state;
    StatusRow& status;
    Captions& captions;
    Dialogs& dialogs;
    DataFolder& data;
    Clock& clock;
};

}  // namespace kdx
