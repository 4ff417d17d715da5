#include "station/readout.h"

#include <algorithm>
#include <array>
#include <set>
#include <stdexcept>
#include <string_view>
#include <utility>

#include "af/othernetwork.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "coder/keyfacts.h"
#include "coder/sendparam.h"
#include "link/coderquestion.h"
#include "link/commandsequence.h"
#include "sim/scpi.h"

namespace kdx {

namespace {

enum class Form {
    Text,    ///< blanks at its end do not count
    Number,  ///< counts by what it means
    OnOff,   ///< answered 1 or 0, sent ON or OFF
    AfList   ///< sent with "N," or "+," in front
};

struct Row {
    std::string_view key;
    std::string_view question;  ///< the coder's name of the value, or the generator's header
    Form form = Form::Text;
    bool generator = false;
};

// In the order in which values are sent: the source switches the coder on and off, the RF output comes last.
constexpr std::array kRows = {
    Row{"MPX_SOURCE", "SRC", Form::Number},
    Row{"MPX_HUB", "MPX-DEV", Form::Number},
    Row{"MPX_IMPEDANZ", "IMP", Form::Number},
    Row{"STEREO_MODE", "MODE", Form::Number},
    Row{"PREEMPHASIS", "PRE", Form::Number},
    Row{"PILOT", "PIL", Form::Number},
    Row{"PILOT_HUB", "PIL-DEV", Form::Number},
    Row{"PILOT_PHASE", "PIL-PH", Form::Number},
    Row{"ARI", "ARI", Form::Number},
    Row{"ARI-HUB", "ARI-DEV", Form::Number},
    Row{"ARI-ID", "ARI-ID", Form::Number},
    Row{"ARI-BK", "BK"},
    Row{"RDS", "RDS", Form::Number},
    Row{"RDS_HUB", "RDS-DEV", Form::Number},
    Row{"RDS_PHASE", "RDS-PH", Form::Number},
    Row{"PI", "PI"},
    Row{"PS", "PS"},
    Row{"PTY", "PTY", Form::Number},
    Row{"TP", "TP", Form::Number},
    Row{"TA", "TA", Form::Number},
    Row{"MS", "MS"},
    Row{"DI", "DI", Form::Number},
    Row{"RT", "RT"},
    Row{"RT_N", "RT-N"},
    Row{"TEST_M", "BIN", Form::Number},
    Row{"AF1", "AF1", Form::AfList},
    Row{"AF2", "AF2", Form::AfList},
    Row{"AF3", "AF3", Form::AfList},
    Row{"AF4", "AF4", Form::AfList},
    Row{"AF5", "AF5", Form::AfList},
    Row{"GROUPSEQ", "GS"},
    Row{"HF-Frequenz", "FREQ", Form::Number, true},
    Row{"HF-Pegel", "POW", Form::Number, true},
    Row{"NF-Frequenz", ":STEREO:AUDIO:FREQ", Form::Number, true},
    Row{"FM", "FM:STAT", Form::Number, true},
    Row{"AM", "AM:STAT", Form::Number, true},
    Row{"HF:PEGEL:STATE", "OUTP:STAT", Form::OnOff, true},
};

// For each other network.
constexpr std::array kNetworkRows = {
    Row{"EON_PS", "EON-PS"},
    Row{"EON_PTY", "EON-PTY", Form::Number},
    Row{"EON_TP", "EON-TP", Form::Number},
    Row{"EON_TA", "EON-TA", Form::Number},
    Row{"EON_AFA", "EON-AFA"},
    Row{"EON_AFB1", "EON-AFB", Form::AfList},
    Row{"EON_AFB2", "EON-AFB", Form::AfList},
    Row{"EON_AFB3", "EON-AFB", Form::AfList},
    Row{"EON_AFB4", "EON-AFB", Form::AfList},
    Row{"EON_AFB5", "EON-AFB", Form::AfList},
};

const Row* rowOf(std::string_view key) {
    const auto in = [key](const auto& rows) {
        const auto row = std::find_if(rows.begin(), rows.end(), [key](const Row& r) { return r.key == key; });
        return row == rows.end() ? nullptr : &*row;
    };
    const Row* own = in(kRows);
    return own != nullptr ? own : in(kNetworkRows);
}

int listNumber(std::string_view key) {
    return key.back() - '0';
}

bool isNumber(std::string_view text) {
    return !text.empty() && sim::readNumber(text) && sim::readNumber(text)->suffix.empty();
}

/// The answer as the row's key takes it.
std::string valueOf(const Row& row, const std::string& answer) {
    std::string text = sim::unquoted(answer).value_or(answer);
    text.erase(text.find_last_not_of(' ') + 1);
    switch (row.form) {
        case Form::Text:
            break;
        case Form::Number:
            if (isNumber(text)) text = shortestDecimal(leadingNumber(text));
            break;
        case Form::OnOff:
            if (isNumber(text)) text = leadingNumber(text) != 0 ? "ON" : "OFF";
            break;
        case Form::AfList:
            if (!text.empty()) text.insert(0, newOrFurtherList(listNumber(row.key)));
            break;
    }
    return text;
}

/// The identifiers in an answer that lists the other networks.
std::vector<std::string> networksIn(const std::string& answer) {
    std::vector<std::string> networks = networksToDelete(sim::unquoted(answer).value_or(answer));
    std::erase_if(networks, [](const std::string& pi) { return pi.size() != kPiLength || !isHex(pi); });
    return networks;
}

/// Asks for all of them. Every instrument tells its name: one that does not has failed. One that keeps silent at
/// another question does not know it, but when its answer only was late, the next one would be taken for the answer to
/// another question: hence it tells its name once more, and when it is another one, nothing further is asked; else the
/// question is put once more.
class Questioner {
public:
    explicit Questioner(Instrument& instrument) : m_instrument(instrument), m_name(instrument.ask(kName, false)) {}

    std::optional<std::string> coder(const std::string& question) { return ask(coderQuestion(question)); }
    void read(const Row& row) {
        const std::string question(row.question);
        keep(row, {}, row.generator ? ask(question + "?") : coder(question));
    }
    void readNetworks() {
        const auto answer = coder("EON-PI");
        if (!answer) m_readout.push_back({std::string(kNetworkKey), {}, std::nullopt});
        for (const std::string& pi : networksIn(answer.value_or(""))) readNetwork(pi);
    }
    [[nodiscard]] Readout take() { return std::move(m_readout); }

private:
    static constexpr const char* kName = "*IDN?";

    void readNetwork(const std::string& pi) {
        m_readout.push_back({std::string(kNetworkKey), pi, pi});
        for (const Row& row : kNetworkRows) {
            std::string question = std::string(row.question) + "," + pi;
            if (row.form == Form::AfList) question += "," + std::to_string(listNumber(row.key));
            keep(row, pi, coder(question));
        }
    }
    std::optional<std::string> ask(const std::string& question) {
        constexpr int kTries = 2;  // silence may have been a busy moment
        std::optional<std::string> answer;
        for (int left = kTries; left > 0 && m_name && !answer; --left) {
            answer = m_instrument.ask(question, true);
            if (!answer && m_instrument.ask(kName, false) != m_name) m_name.reset();
        }
        return answer;
    }
    void keep(const Row& row, const std::string& network, const std::optional<std::string>& answer) {
        Reading reading{std::string(row.key), network, std::nullopt};
        if (answer) reading.value = valueOf(row, *answer);
        m_readout.push_back(std::move(reading));
    }

    Instrument& m_instrument;
    std::optional<std::string> m_name;
    Readout m_readout;
};

const Reading* find(const Readout& readout, std::string_view key, std::string_view network) {
    const auto found = std::find_if(readout.begin(), readout.end(), [&](const Reading& reading) {
        return reading.key == key && reading.network == network;
    });
    return found == readout.end() ? nullptr : &*found;
}

std::string valueIn(const Readout& readout, std::string_view key, std::string_view network = {}) {
    const Reading* reading = find(readout, key, network);
    return reading != nullptr ? reading->value.value_or("") : std::string();
}

/// What makes the wanted values of one key after another the present ones. A text with a double quote goes out by no
/// command unless its quotes are doubled: the instrument would take it for ended there.
class Commands {
public:
    Commands(const Readout& wanted, const Corrections& corrections)
        : m_wanted(wanted), m_doublesQuotes(corrections.quotes) {}

    void add(const std::string& key, std::string value, const std::string& network = {}) {
        const ParamContext context{.eonIdentifier = network, .clockText = {}, .time = {}, .date = {}};
        try {
            const std::string command = composeCommand(key, value, context).value_or("");
            if (!command.empty()) addText(key, command);
        } catch (const std::overflow_error&) {  // a number that no instrument has: it does not come back
        }
    }
    void addText(const std::string& key, const std::string& command) {
        std::string doubled = quotesDoubled(command);
        if (m_doublesQuotes || doubled == command) m_commands.push_back({key, std::move(doubled)});
    }

    void addOwn(const std::string& key) {
        const std::string value = valueIn(m_wanted, key);
        const Row* row = rowOf(key);
        if (row == nullptr) return;
        if (row->form == Form::AfList) {
            addLists("AF", {});
        } else if (key == "RT" || key == "RT_N") {
            addRadiotext();
        } else if (key == "FM") {
            add(value == "0" ? "FM_AUS" : "FM_EIN", {});
        } else if (key == "AM") {
            // The program itself never switches amplitude modulation on.
            value == "0" ? add("AM_AUS", {}) : addText(key, "AM:STAT ON");
        } else if (key != "GROUPSEQ" || !value.empty()) {
            add(key, value);
        }
    }
    /// The lists replace each other as a whole.
    void addLists(const std::string& prefix, const std::string& network) {
        if (!once(prefix + network)) return;
        std::vector<std::pair<std::string, std::string>> lists;
        for (int list = 1; list <= kAfLists; ++list) {
            const std::string key = prefix + std::to_string(list);
            if (!isKnown(key, network)) return;
            const std::string value = valueIn(m_wanted, key, network);
            if (!value.empty()) lists.emplace_back(key, value);
        }
        for (const auto& [key, value] : lists) add(key, value, network);
    }
    void addNetworkValue(const std::string& key, const std::string& network) {
        const Row* row = rowOf(key);
        if (row != nullptr && row->form == Form::AfList) {
            addLists("EON_AFB", network);
        } else if (const std::string value = valueIn(m_wanted, key, network); !value.empty()) {
            add(key, value, network);
        }
    }
    void addWholeNetwork(const std::string& network) {
        add(std::string(kNetworkKey), network);
        for (const Row& row : kNetworkRows) addNetworkValue(std::string(row.key), network);
    }
    [[nodiscard]] SettingCommands take() { return std::move(m_commands); }

private:
    /// True for the first time.
    bool once(const std::string& what) { return m_done.insert(what).second; }
    /// A list or a text that was not read must not be taken for an empty one.
    [[nodiscard]] bool isKnown(const std::string& key, const std::string& network) const {
        const Reading* reading = find(m_wanted, key, network);
        return reading == nullptr || reading->value;
    }
    /// Text and numbers go out in one command.
    void addRadiotext() {
        if (!isKnown("RT", {}) || !once("RT")) return;
        std::string value = valueIn(m_wanted, "RT_N");
        value = (value.empty() ? "10,0" : value) + "," + valueIn(m_wanted, "RT");
        addText("RT", coderCommand("RT=" + value));
    }

    const Readout& m_wanted;
    bool m_doublesQuotes;
    SettingCommands m_commands;
    std::set<std::string> m_done;
};

/// A list that a network has too much goes only with the network.
bool mustBeginAnew(const Difference& difference) {
    const Row* row = rowOf(difference.key);
    const bool list = row != nullptr && (row->form == Form::AfList || row->key == "EON_AFA");
    return list && difference.wanted == "" && difference.present != "";
}

}  // namespace

Readout readOut(Instrument& instrument) {
    const CommandSequence sequence(instrument);
    Questioner questioner(instrument);
    for (const Row& row : kRows) questioner.read(row);
    questioner.readNetworks();
    return questioner.take();
}

Readout unanswered(const Readout& readout) {
    Readout silent;
    std::copy_if(readout.begin(), readout.end(), std::back_inserter(silent), [](const Reading& r) { return !r.value; });
    return silent;
}

Differences differences(const Readout& wanted, const Readout& present) {
    Differences differing;
    const bool networksKnown = find(wanted, kNetworkKey, {}) == nullptr && find(present, kNetworkKey, {}) == nullptr;
    for (const Reading& one : wanted) {
        if (!one.network.empty() && !networksKnown) continue;
        const Reading* other = find(present, one.key, one.network);
        if (other == nullptr) {
            if (networksKnown && one.key == kNetworkKey)
                differing.push_back({one.key, one.network, one.value, std::nullopt});
        } else if (one.value && other->value && one.value != other->value) {
            differing.push_back({one.key, one.network, one.value, other->value});
        }
    }
    for (const Reading& other : present) {
        if (networksKnown && other.key == kNetworkKey && find(wanted, kNetworkKey, other.network) == nullptr)
            differing.push_back({other.key, other.network, std::nullopt, other.value});
    }
    return differing;
}

SettingCommands commandsFor(const Differences& differing, const Readout& wanted, const Corrections& corrections) {
    Commands commands(wanted, corrections);
    // Networks that go make room for those that come: the coder holds a limited number.
    std::set<std::string> whole;
    for (const Difference& difference : differing) {
        const bool goes = difference.key == kNetworkKey ? !difference.wanted : mustBeginAnew(difference);
        if (difference.network.empty() || !goes || !whole.insert(difference.network).second) continue;
        commands.add("EON_DEL", difference.network);
        if (difference.key != kNetworkKey) commands.addWholeNetwork(difference.network);
    }
    for (const Difference& difference : differing) {
        if (difference.network.empty() || whole.count(difference.network) != 0) continue;
        if (difference.key == kNetworkKey) {
            commands.addWholeNetwork(difference.network);
        } else {
            commands.addNetworkValue(difference.key, difference.network);
        }
    }
    for (const Difference& difference : differing) {
        if (difference.network.empty()) commands.addOwn(difference.key);
    }
    return commands.take();
}

bool setsReading(const std::string& sent, const std::string& key) {
    if (key == "FM" || key == "AM") return sent == key + "_EIN" || sent == key + "_AUS";
    if (key == "RT" || key == "RT_N") return sent == "RT" || sent == "DEL_RT";
    if (key.starts_with("EON_")) return sent == kNetworkKey || sent == "EON_DEL" || sent == key;
    return sent == key || (key.starts_with("AF") && sent.starts_with("AF"));
}

std::string meaningOf(const std::string& key) {
    if (key == "RT_N") return "radiotext: how often, A/B flag";
    if (key == "FM") return "frequency modulation";
    if (key == "AM") return "amplitude modulation";
    const KeyFacts* facts = factsOf(key);
    return facts == nullptr ? std::string() : std::string(facts->meaning);
}

}  // namespace kdx
