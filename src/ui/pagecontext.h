#pragma once

namespace kdx {

class Captions;
class Clock;
class DataFolder;
class Dialogs;
class Instrument;
class KeyMarks;
class ParamSender;
class Profile;
class StatusRow;
class TickerGroup;
struct ProgramState;

/// What a page works with; everything is borrowed and outlives the page.
struct PageContext {
    ParamSender& params;
    Instrument& instrument;
    Profile& profile;
    ProgramState& state;
    StatusRow& status;
    const Captions& captions;
    Dialogs& dialogs;
    DataFolder& data;
    Clock& clock;
    TickerGroup& tickers;
    KeyMarks& marks;
};

}  // namespace kdx
