#include "coder/sendparam.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <stdexcept>
#include <utility>

#include "base/clock.h"
#include "base/codepage.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "link/instrument.h"
#include "settings/programstate.h"

namespace kdx {

namespace {

constexpr std::string_view kCoderCommand = ":STEREO:DIRECT ";

constexpr const char* kEndKey = "DS";

/// How a command travels.
enum class Route {
    Direct,  ///< a coder command inside the generator's pass-through command
    Eon,     ///< the same, its value led by the other network's identifier and a comma
    Scpi,    ///< a generator command, as it stands
};

/// What stands between a command's text and its unit.
enum class Format {
    Ignored,        ///< nothing: the command says it all
    AsGiven,        ///< the value
    Pad8,           ///< 8 characters, padded with blanks or cut
    Pad4,           ///< 4 characters, padded with blanks or cut
    Pad4WriteBack,  ///< the same, and the caller's value becomes these 4 characters
    TwoDigits,      ///< the last 2 characters of "00" and the value
    Deviation,      ///< the value times 10
    ShownClock,     ///< "off", or the time that the clock page shows and the date
    PcClock,        ///< the PC's time and date
    Choice,         ///< the command that kChoiceTable has for the value, none for any other value
};

struct ParamRow {
    std::string_view key;
    Route route;
    std::string_view command;
    Format format;
    std::string_view unit = {};
};

// Upper and lower case, and commands with and without a leading colon, are mixed as the generator's command set was
// tried out with; keep every text verbatim.
constexpr std::array kParamTable = {
    ParamRow{"PS", Route::Direct, "PS=", Format::Pad8},
    ParamRow{"PI", Route::Direct, "PI=", Format::Pad4WriteBack},
    ParamRow{"PTY", Route::Direct, "PTY=", Format::TwoDigits},
    ParamRow{"TP", Route::Scpi, "", Format::Choice},
    ParamRow{"TA", Route::Direct, "TA=", Format::AsGiven},
    ParamRow{"MS", Route::Direct, "MS=", Format::AsGiven},
    ParamRow{"DI", Route::Direct, "DI=", Format::AsGiven},
    ParamRow{"RT", Route::Direct, "RT=10,0,", Format::AsGiven},
    ParamRow{"RTA", Route::Direct, "RT=5,1,", Format::AsGiven},
    ParamRow{"DEL_RT", Route::Direct, "RT=0,0,", Format::Ignored},
    ParamRow{"UHR", Route::Direct, "CT=", Format::ShownClock},
    ParamRow{"ZEIT", Route::Direct, "CT=", Format::PcClock},
    ParamRow{"RDS", Route::Scpi, "", Format::Choice},
    ParamRow{"RDS_HUB", Route::Scpi, ":STEREO:RDS:DEVIATION ", Format::Deviation, "HZ"},
    ParamRow{"RDS_PHASE", Route::Direct, "RDS-PH=", Format::AsGiven},
    ParamRow{"AF1", Route::Direct, "AF=", Format::AsGiven},
    ParamRow{"AF2", Route::Direct, "AF=", Format::AsGiven},
    ParamRow{"AF3", Route::Direct, "AF=", Format::AsGiven},
    ParamRow{"AF4", Route::Direct, "AF=", Format::AsGiven},
    ParamRow{"AF5", Route::Direct, "AF=", Format::AsGiven},
    ParamRow{"GROUPSEQ", Route::Direct, "GS=", Format::AsGiven},
    ParamRow{"GROUPSEQ_TN", Route::Direct, "GS=", Format::AsGiven},
    ParamRow{"STORE", Route::Direct, "STORE=", Format::AsGiven},
    ParamRow{"ODA", Route::Direct, "3A=", Format::AsGiven},
    ParamRow{"TMC", Route::Direct, "8A=", Format::AsGiven},
    ParamRow{"TEST_M", Route::Direct, "BIN=", Format::AsGiven},
    ParamRow{"TEST_D", Route::Direct, "BIN=", Format::AsGiven},
    ParamRow{"EON_PI", Route::Direct, "EON-PI=", Format::Pad4},
    ParamRow{"EON_PS", Route::Eon, "EON-PS=", Format::Pad8},
    ParamRow{"EON_PTY", Route::Eon, "EON-PTY=", Format::AsGiven},
    ParamRow{"EON_TP", Route::Eon, "EON-TP=", Format::AsGiven},
    ParamRow{"EON_TA", Route::Eon, "EON-TA=", Format::AsGiven},
    ParamRow{"EON_AFA", Route::Eon, "EON-AFA=", Format::AsGiven},
    ParamRow{"EON_AFB1", Route::Eon, "EON-AFB=", Format::AsGiven},
    ParamRow{"EON_AFB2", Route::Eon, "EON-AFB=", Format::AsGiven},
    ParamRow{"EON_AFB3", Route::Eon, "EON-AFB=", Format::AsGiven},
    ParamRow{"EON_AFB4", Route::Eon, "EON-AFB=", Format::AsGiven},
    ParamRow{"EON_AFB5", Route::Eon, "EON-AFB=", Format::AsGiven},
    ParamRow{"EON_DEL", Route::Direct, "EON-DEL=", Format::AsGiven},
    ParamRow{"MPX_HUB", Route::Scpi, ":STEREO:DEVIATION ", Format::Deviation, "HZ"},
    ParamRow{"MPX_SOURCE", Route::Scpi, "", Format::Choice},
    ParamRow{"MPX_IMPEDANZ", Route::Scpi, "", Format::Choice},
    ParamRow{"STEREO_MODE", Route::Scpi, "", Format::Choice},
    ParamRow{"PREEMPHASIS", Route::Scpi, "", Format::Choice},
    ParamRow{"PILOT", Route::Scpi, "", Format::Choice},
    ParamRow{"PILOT_HUB", Route::Scpi, ":STEREO:PILOT:DEVIATION ", Format::Deviation, "HZ"},
    ParamRow{"PILOT_PHASE", Route::Scpi, ":STEREO:PILOT:PHASE ", Format::AsGiven, "DEG"},
    ParamRow{"ARI", Route::Scpi, "", Format::Choice},
    ParamRow{"ARI-HUB", Route::Scpi, ":stereo:ari:deviation ", Format::Deviation, "HZ"},
    ParamRow{"ARI-ID", Route::Scpi, "", Format::Choice},
    ParamRow{"ARI-BK", Route::Scpi, ":stereo:ari:bk ", Format::AsGiven},
    ParamRow{"STEREO_EIN", Route::Scpi, "STEREO:STAT ON", Format::Ignored},
    ParamRow{"STEREO_AUS", Route::Scpi, "STEREO:STAT OFF", Format::Ignored},
    ParamRow{"FM_EIN", Route::Scpi, "FM:STAT ON", Format::Ignored},
    ParamRow{"FM_AUS", Route::Scpi, "FM:STAT OFF", Format::Ignored},
    ParamRow{"AM_AUS", Route::Scpi, "AM:STAT OFF", Format::Ignored},
    ParamRow{"HF:PEGEL:STATE", Route::Scpi, ":OUTPUT:STAT ", Format::AsGiven},
    ParamRow{"HF-Frequenz", Route::Scpi, "FREQ ", Format::AsGiven, "MHZ"},
    ParamRow{"HF-Pegel", Route::Scpi, ":POW ", Format::AsGiven, "DBUV"},
    ParamRow{"NF-Frequenz", Route::Scpi, ":STEREO:AUDIO:FREQ ", Format::AsGiven, "KHZ"},
    // "NFShape Sinus" has no row: the generator knows no waveform command for it, so it is passed over.
};

struct ChoiceRow {
    std::string_view key;
    std::string_view value;
    std::string_view command;
};

constexpr std::array kChoiceTable = {
    ChoiceRow{"TP", "0", ":stereo:rds:traffic:program OFF"},
    ChoiceRow{"TP", "1", ":stereo:rds:traffic:program ON"},
    ChoiceRow{"RDS", "0", ":stereo:rds:state OFF"},
    ChoiceRow{"RDS", "1", ":stereo:rds:state ON"},
    ChoiceRow{"MPX_SOURCE", "0", "STEREO:STAT OFF"},
    ChoiceRow{"MPX_SOURCE", "1", "STEREO:STAT ON;:stereo:source LREXT"},
    ChoiceRow{"MPX_SOURCE", "2", "STEREO:STAT ON;:stereo:source SPEXT"},
    ChoiceRow{"MPX_SOURCE", "3", "STEREO:STAT ON;:stereo:source LFGEN"},
    ChoiceRow{"MPX_IMPEDANZ", "1", ":STEREO:EXTERNAL:IMP 600"},
    ChoiceRow{"MPX_IMPEDANZ", "2", ":STEREO:EXTERNAL:IMP 100000"},
    ChoiceRow{"STEREO_MODE", "1", ":stereo:audio:mode LEFT"},
    ChoiceRow{"STEREO_MODE", "2", ":stereo:audio:mode RIGHT"},
    ChoiceRow{"STEREO_MODE", "3", ":stereo:audio:mode REL"},
    ChoiceRow{"STEREO_MODE", "4", ":stereo:audio:mode REML"},
    ChoiceRow{"STEREO_MODE", "5", ":stereo:audio:mode RNEL"},
    ChoiceRow{"PREEMPHASIS", "0", ":stereo:audio:preemphasis:state OFF"},
    ChoiceRow{"PREEMPHASIS", "1", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 50us"},
    ChoiceRow{"PREEMPHASIS", "2", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 75us"},
    ChoiceRow{"PILOT", "0", ":stereo:pilot:state OFF"},
    ChoiceRow{"PILOT", "1", ":stereo:pilot:state ON"},
    ChoiceRow{"ARI", "0", ":stereo:ari:state OFF"},
    ChoiceRow{"ARI", "1", ":stereo:ari:state ON"},
    ChoiceRow{"ARI-ID", "0", ":stereo:ari:type:state OFF"},
    ChoiceRow{"ARI-ID", "1", ":stereo:ari:type:state ON;:stereo:ari:type DK"},
    ChoiceRow{"ARI-ID", "2", ":stereo:ari:type:state ON;:stereo:ari:type BK"},
    ChoiceRow{"ARI-ID", "3", ":stereo:ari:type:state ON;:stereo:ari:type BKDK"},
};

constexpr bool sameRow(const ParamRow& left, const ParamRow& right) {
    return left.key == right.key;
}

constexpr bool sameRow(const ChoiceRow& left, const ChoiceRow& right) {
    return left.key == right.key && left.value == right.value;
}

template <typename Table>
constexpr bool keysAreUnique(const Table& table) {
    for (auto row = table.begin(); row != table.end(); ++row) {
        for (auto other = row + 1; other != table.end(); ++other) {
            if (sameRow(*row, *other)) return false;
        }
    }
    return true;
}

constexpr const ParamRow* paramRow(std::string_view key) {
    for (const ParamRow& row : kParamTable) {
        if (row.key == key) return &row;
    }
    return nullptr;
}

constexpr bool choicesBelongToTheirRows() {
    return std::all_of(kChoiceTable.begin(), kChoiceTable.end(), [](const ChoiceRow& choice) {
        const ParamRow* row = paramRow(choice.key);
        return row != nullptr && row->format == Format::Choice;
    });
}

static_assert(keysAreUnique(kParamTable));
static_assert(keysAreUnique(kChoiceTable));
static_assert(choicesBelongToTheirRows());

std::string tenfold(std::string_view value) {
    const double product = leadingNumber(value) * 10;
    if (!std::isfinite(product)) throw std::overflow_error("deviation too large: " + std::string(value));
    return shortestDecimal(product);
}

std::string shownClock(std::string_view value, const ParamContext& context) {
    // "OFF" counts in any letter case, "AUS" in capitals only: "aus" sends the clock. Stored data sets rely on it.
    if (upperCase(value) == "OFF" || value == "AUS") return "off";
    return context.clockText + "," + context.date;
}

std::string_view chosenCommand(std::string_view key, std::string_view value) {
    for (const ChoiceRow& choice : kChoiceTable) {
        if (choice.key == key && choice.value == value) return choice.command;
    }
    return {};
}

std::string formatted(const ParamRow& row, std::string& value, const ParamContext& context) {
    switch (row.format) {
        case Format::Ignored:
            return {};
        case Format::AsGiven:
            return value;
        case Format::Pad8:
            return padRight(value, kPsLength);
        case Format::Pad4:
            return padRight(value, kPiLength);
        case Format::Pad4WriteBack:
            value = padRight(value, kPiLength);
            return value;
        case Format::TwoDigits:
            return rightmost("00" + value, 2);
        case Format::Deviation:
            return tenfold(value);
        case Format::ShownClock:
            return shownClock(value, context);
        case Format::PcClock:
            return context.time + "," + context.date;
        case Format::Choice:
            return std::string(chosenCommand(row.key, value));
    }
    return {};
}

/// What stands between the outer quotes of a command for the coder.
std::optional<std::string_view> textInside(std::string_view command) {
    if (!command.starts_with(kCoderCommand)) return std::nullopt;
    const std::string_view text = command.substr(kCoderCommand.size());
    if (text.size() < 2 || !text.starts_with('"') || !text.ends_with('"')) return std::nullopt;
    return text.substr(1, text.size() - 2);
}

std::string dateText(const Date& date) {
    return twoDigits(date.day) + "." + twoDigits(date.month) + "." + twoDigits(date.year % 100);
}

}  // namespace

bool isParameter(std::string_view key) {
    return paramRow(key) != nullptr;
}

std::optional<std::string> composeCommand(std::string_view key, std::string& value, const ParamContext& context) {
    const ParamRow* row = paramRow(key);
    if (row == nullptr) return std::nullopt;
    std::string command(row->command);
    if (row->route == Route::Eon) command.append(context.eonIdentifier).append(",");
    command.append(formatted(*row, value, context)).append(row->unit);
    return row->route == Route::Scpi ? command : coderCommand(command);
}

std::string coderCommand(std::string_view command) {
    return std::string(kCoderCommand).append("\"").append(command).append("\"");
}

std::string quotesDoubled(std::string_view command) {
    const auto text = textInside(command);
    if (!text) return std::string(command);
    std::string doubled;
    for (const char c : *text) doubled.append(c == '"' ? 2 : 1, c);
    return std::string(kCoderCommand).append("\"").append(doubled).append("\"");
}

bool endsItsTextEarly(std::string_view command) {
    const std::string_view text = textInside(command).value_or("");
    for (std::size_t at = text.find('"'); at != std::string_view::npos; at = text.find('"', at + 2)) {
        if (!text.substr(at + 1).starts_with('"')) return true;
    }
    return false;
}

bool leavesItsTextOpen(std::string_view command) {
    return command.starts_with(kCoderCommand) && !textInside(command);
}

ParamSender::ParamSender(Instrument& instrument, ProgramState& state, Clock& clock, std::function<void()> endProgram)
    : m_instrument(instrument), m_state(state), m_clock(clock), m_endProgram(std::move(endProgram)) {}

void ParamSender::SendParam(const std::string& key, std::string& value, const std::string& /*extra1*/,
                            const std::string& /*extra2*/, std::int16_t& /*mode*/) {
    if (key == kEndKey) {
        // No control uses this key; a data set that holds it ends the program when it is sent.
        m_endProgram();
        return;
    }
    if (const auto command = compose(key, value)) sendCommand(key, *command);
}

std::optional<std::string> ParamSender::compose(const std::string& key, std::string& value) const {
    const ParamContext context{m_state.eonIdentifier, m_state.shownClock, timeText(m_clock), dateText(m_clock.today())};
    std::optional<std::string> command = composeCommand(key, value, context);
    if (command && m_state.corrections.quotes) command = quotesDoubled(*command);
    return command;
}

void ParamSender::sendCommand(const std::string& key, const std::string& command) {
    if (m_instrument.isSequenceStopped()) return;
    noteQuotes(key, command);
    m_instrument.WriteLog(key, "", command);
    // Gives the coder time to take one command before the next; without a session nothing is sent to it.
    if (m_state.InstrumentOnline) WaitMs(m_clock, kCommandPauseMs);
    if (m_instrument.isSequenceStopped()) return;  // in the pause
    if (m_composed) m_composed(command);
    m_instrument.Send2Gen(command);
    if (m_written && m_state.InstrumentOnline) m_written(key, command, m_instrument.LastVisaStatus >= 0);
}

void ParamSender::noteQuotes(const std::string& key, std::string_view command) {
    const bool changed = endsItsTextEarly(command) ? m_quotedKeys.insert(key).second : m_quotedKeys.erase(key) > 0;
    if (changed && m_quotedKeysChanged) m_quotedKeysChanged();
}

void ParamSender::SendParam(const std::string& key, std::string& value) {
    SendParam(key, value, {}, {}, m_state.sendMode);
}

void ParamSender::SendParam(const std::string& key, std::string&& value) {
    SendParam(key, value);
}

}  // namespace kdx
