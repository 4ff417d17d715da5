#include "coder/readback.h"

#include "base/codepage.h"
#include "base/numbers.h"
#include "link/instrument.h"
#include "settings/captions.h"
#include "settings/corrections.h"

namespace kdx {

namespace readback {

std::string decoderInfo(const std::string& answer, const Captions& captions) {
    if (answer == "0") return "Mono";
    if (answer == "1") return "Stereo";
    if (answer == "2" || answer == "7") return "NN";
    if (answer == "3") return "Stereo Kunstkopf";
    if (answer == "4") return "Mono compressed";
    if (answer == "5") return "Stereo compressed";
    // The closing quote belongs to the text as it has always been shown.
    if (answer == "6") return "Stereo compressed Kunstkopf\"";
    return captions.text(143);
}

std::string musicSpeech(const std::string& answer, const Captions& captions) {
    if (answer == "S") return captions.text(57);
    if (answer == "M") return captions.text(56);
    return answer.empty() ? captions.text(143) : answer;
}

std::string preemphasis(const std::string& answer, const Captions& captions) {
    if (answer == "0") return captions.text(22);
    if (answer == "1") return fromUtf8("50µs");
    if (answer == "2") return fromUtf8("75µs");
    return answer.empty() ? captions.text(143) : answer;
}

std::string impedance(const std::string& answer) {
    if (answer == "2") return "Impedanz 100k ";
    if (answer == "1") return "Impedanz 600 ";
    return {};
}

std::string ariType(const std::string& answer, const Captions& captions) {
    if (answer == "0") return captions.text(193);
    if (answer == "1") return "DK";
    if (answer == "2") return "BK";
    if (answer == "3") return "BK + DK";
    return answer.empty() ? captions.text(143) : answer;
}

std::string onOff(const std::string& answer, const Captions& captions) {
    if (answer == "1") return captions.text(192);
    if (answer == "0") return captions.text(193);
    return answer;
}

std::string deviation(const std::string& answer, const Captions& captions) {
    if (answer.empty()) return {};
    return captions.text(21) + ": " + shortestDecimal(leadingNumber(answer) * 10) + " Hz";
}

}  // namespace readback

namespace {

using Answers = std::vector<std::string>;
using Queries = std::vector<Query>;

std::string asItStands(const Answers& answers, const Captions& /*captions*/) {
    return answers[0];
}

std::string ari(const Answers& answers, const Captions& captions) {
    return "ARI " + readback::onOff(answers[0], captions) + "\nARI " + readback::deviation(answers[1], captions) +
           "\n" + readback::ariType(answers[2], captions) + "\n" + answers[3];
}

std::string afLists(const Answers& answers, const Captions& /*captions*/) {
    std::string text;
    for (std::size_t i = 0; i < answers.size(); ++i) {
        if (i > 0) text += "\n";
        text += "AF" + std::to_string(i + 1) + ": " + answers[i];
    }
    return text;
}

std::string fmDeviation(const Answers& answers, const Captions& captions) {
    return answers[0].empty() ? std::string() : "FM " + readback::deviation(answers[0], captions);
}

std::string pilot(const Answers& answers, const Captions& captions) {
    return "Pilot " + readback::onOff(answers[0], captions) + "\n" + readback::deviation(answers[1], captions) +
           "\nPhase: " + answers[2] + fromUtf8("°");
}

std::string rds(const Answers& answers, const Captions& captions) {
    return "RDS " + readback::onOff(answers[0], captions) + "\n" + readback::deviation(answers[1], captions);
}

std::string eon(const Answers& answers, const Captions& /*captions*/) {
    std::string text = "EON-PI:  " + answers[0] + " / EON-PS:  " + answers[1] + " / EON-TP:  " + answers[2] +
                       " / EON-TA:  " + answers[3];
    for (std::size_t list = 1; list <= 5; ++list) {
        text += " / \nEON-AFB" + std::to_string(list) + ":  " + answers[3 + list];
    }
    return text;
}

// The unit is not the one that the level is set in, and the answer is not converted.
std::string level(const Answers& answers, const Captions& /*captions*/) {
    return answers[0] + " dBm";
}

Queries afQueries(const std::string& /*eonIdentifier*/) {
    Queries queries;
    for (int list = 1; list <= 5; ++list) {
        queries.push_back({"AF_Liste" + std::to_string(list) + "?", "AF" + std::to_string(list)});
    }
    return queries;
}

Queries eonQueries(const std::string& eonIdentifier) {
    Queries queries = {{"EON PI?", "EON-PI"},
                       {"EON PS?", "EON-PS," + eonIdentifier},
                       {"EON TP?", "EON-TP," + eonIdentifier},
                       {"EON TA?", "EON-TA," + eonIdentifier}};
    for (int list = 1; list <= 5; ++list) {
        queries.push_back({"EON AFB?", "EON-AFB," + eonIdentifier + "," + std::to_string(list)});
    }
    return queries;
}

using Ask = const std::string&;

}  // namespace

std::vector<std::string> ask(Instrument& instrument, const ReadBack& readBack, const std::string& eonIdentifier) {
    std::vector<std::string> answers;
    for (const Query& query : readBack.queries(eonIdentifier)) {
        answers.push_back(readBack.generator ? instrument.VRN_Abfrage(query.label, query.key)
                                             : instrument.X4_Abfrage(query.label, query.key));
    }
    return answers;
}

std::string wordsOf(const ReadBack& readBack, const std::vector<std::string>& answers, const Captions& captions,
                    const Corrections& corrections) {
    if (readBack.words == level && corrections.levelUnit) return answers[0] + fromUtf8(" dBµV");
    return readBack.words(answers, captions);
}

const std::vector<ReadBack>& readBacks() {
    static const std::vector<ReadBack> all = {
        // "Stereo Mode??" bears two question marks; it reaches the log only.
        {"ari", "ARI signal: on, deviation, identification, area", "Command1", "A R I ?", 134, false,
         [](Ask) -> Queries {
             return {{"Ari ein/aus?", "ARI"}, {"ARI Hub?", "ARI-DEV"}, {"ARI mode?", "ARI-ID"}, {"BK?", "BK"}};
         },
         ari},
        {"af", "lists of alternative frequencies", "Command4", "AF ?", 126, false, afQueries, afLists},
        {"ps", "programme service name", "Command5", "PS ?", 123, false,
         [](Ask) -> Queries {
             return {{"PS?", "PS"}};
         },
         asItStands},
        {"pi", "programme identification", "Command6", "PI ?", 127, false,
         [](Ask) -> Queries {
             return {{"PI?", "PI"}};
         },
         asItStands},
        {"pty", "programme type", "Command7", "PTY ?", 124, false,
         [](Ask) -> Queries {
             return {{"PTY?", "PTY"}};
         },
         asItStands},
        {"rt", "radiotext", "Command8", "RT ?", 125, false,
         [](Ask) -> Queries {
             return {{"RT?", "RT"}};
         },
         asItStands},
        {"time", "clock time", "Command9", "Zeit ?", 130, false,
         [](Ask) -> Queries {
             return {{"CT?", "CT"}};
         },
         asItStands},
        {"frequency", "RF frequency", "Command10", "Freq ?", 520, true,
         [](Ask) -> Queries {
             return {{"Freq?", "FREQ"}};
         },
         [](const Answers& answers, const Captions&) { return answers[0] + " MHz"; }},
        {"deviation", "total deviation", "Command11", "FM Hub ?", 135, false,
         [](Ask) -> Queries {
             return {{"MPX Hub?", "MPX-DEV"}};
         },
         fmDeviation},
        {"source", "source of the modulation", "Command12", "FM Source ?", 136, false,
         [](Ask) -> Queries {
             return {{"Mod Eingang?", "SRC"}};
         },
         [](const Answers& answers, const Captions&) { return "Mod Quelle: " + answers[0]; }},
        {"preemphasis", "preemphasis", "Command13", "Pre.phase ?", 137, false,
         [](Ask) -> Queries {
             return {{"Preemphasis?", "PRE"}};
         },
         [](const Answers& answers, const Captions& captions) { return readback::preemphasis(answers[0], captions); }},
        {"pilot", "pilot tone: on, deviation, phase", "Command14", "Pilot-Ton ?", 132, false,
         [](Ask) -> Queries {
             return {{"Pilot?", "PIL"}, {"Pilot Hub?", "PIL-DEV"}, {"Pilot Phase?", "PIL-PH"}};
         },
         pilot},
        {"mode", "stereo mode", "Command15", "Ster.-Mode ?", 133, false,
         [](Ask) -> Queries {
             return {{"Stereo Mode??", "MODE"}};
         },
         asItStands},
        {"rds", "RDS subcarrier: on, deviation", "Command16", "R D S ?", 131, false,
         [](Ask) -> Queries {
             return {{"RDS?", "RDS"}, {"RDS-Hub?", "RDS-DEV"}};
         },
         rds},
        {"groups", "group sequence", "Command17", "Gruppen ?", 122, false,
         [](Ask) -> Queries {
             return {{"Gruppenfolge?", "GS"}};
         },
         asItStands},
        {"impedance", "input impedance", "Command18", "Impedanz ?", 138, false,
         [](Ask) -> Queries {
             return {{"Impedanz?", "IMP"}};
         },
         [](const Answers& answers, const Captions&) { return readback::impedance(answers[0]); }},
        {"eon", "other network", "Command19", "EON  ?", 121, false, eonQueries, eon},
        {"ms", "music or speech", "Command20", "M / S ?", 129, false,
         [](Ask) -> Queries {
             return {{"M/S ?", "MS"}};
         },
         [](const Answers& answers, const Captions& captions) { return readback::musicSpeech(answers[0], captions); }},
        {"di", "decoder information", "Command21", "D I ?", 128, false,
         [](Ask) -> Queries {
             return {{"Decoder?", "DI"}};
         },
         [](const Answers& answers, const Captions& captions) { return readback::decoderInfo(answers[0], captions); }},
        {"level", "RF level", "Command22", "Pegel ?", 521, true,
         [](Ask) -> Queries {
             return {{"Pegel?", "POW"}};
         },
         level},
    };
    return all;
}

}  // namespace kdx
