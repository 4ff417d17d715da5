#include "onair/differences.h"

#include <algorithm>
#include <optional>
#include <string_view>

#include "air/groupring.h"
#include "air/shadow.h"
#include "base/codepage.h"
#include "coder/fieldsizes.h"
#include "coder/rdscharacters.h"
#include "station/station.h"

namespace kdx {

namespace {

using Row = AirDifference::Row;
using Why = AirDifference::Why;

std::string withoutBlanksBehind(std::string_view text) {
    return std::string(text.substr(0, text.find_last_not_of(' ') + 1));
}

std::string padded(std::string_view text, std::size_t length) {
    std::string result(text.substr(0, length));
    result.resize(length, ' ');
    return result;
}

/// How a text that was entered differs from the one that the coder sends.
std::optional<AirDifference> ofText(Row row, const std::string& entry, std::string_view sent, std::size_t length) {
    const std::string_view sendable = std::string_view(entry).substr(0, length);
    if (withoutBlanksBehind(sendable) != withoutBlanksBehind(sent)) return AirDifference{row, Why::Other, entry};
    if (const auto character = withoutRdsCode(sendable))
        return AirDifference{row, Why::NoPlace, std::string(1, *character)};
    if (entry.size() > length) return AirDifference{row, Why::Cut, entry};
    return std::nullopt;
}

std::optional<AirDifference> ofPs(const std::string& entry, std::string_view sent) {
    auto difference = ofText(Row::Ps, entry, sent, kPsLength);
    if (difference || entry.size() == kPsLength) return difference;
    return AirDifference{Row::Ps, Why::Padded, entry};
}

/// How a choice that was made differs; one that was not made does not.
std::optional<AirDifference> ofChoice(Row row, const std::string& entry, const std::string& sent) {
    if (entry.empty() || entry == sent) return std::nullopt;
    return AirDifference{row, Why::Other, entry};
}

std::string flag(bool on) {
    return on ? "1" : "0";
}

/// How the radiotext that was entered differs from what the groups of the sequence carry of it.
std::optional<AirDifference> ofRadiotext(const std::string& entry, const sim::Setup& sent) {
    if (auto difference = ofText(Row::Radiotext, entry, sent.radiotext, kRadiotextLength)) return difference;
    const auto ring = air::groupRing(sent.groupSequence);
    const auto has = [&ring](air::GroupType type) { return std::ranges::find(ring, type) != ring.end(); };
    if (entry.empty() || has(air::GroupType::Radiotext2A)) return std::nullopt;
    if (!has(air::GroupType::Radiotext2B)) return AirDifference{Row::Radiotext, Why::Other, entry};
    constexpr std::size_t kShortRadiotext = 32;  // of groups 2B
    if (entry.size() <= kShortRadiotext) return std::nullopt;
    return AirDifference{Row::Radiotext, Why::Cut, entry};
}

class Rows {
public:
    explicit Rows(const air::Shadow& shadow) : m_shadow(shadow) {}

    /// @param setting the coder's name of it, by which commands are refused; @param entry what they were to set, of
    /// which no more than the length goes out.
    void add(std::string_view setting, const std::string& entry, std::optional<AirDifference> difference,
             std::size_t length = std::string_view::npos) {
        const std::string_view goesOut = std::string_view(entry).substr(0, length);
        if (difference && difference->why == Why::Other && m_shadow.isRefused(setting, goesOut))
            difference = AirDifference{difference->row, Why::Refused, entry};
        if (difference) m_rows.push_back(*std::move(difference));
    }
    std::vector<AirDifference> take() { return std::move(m_rows); }

private:
    const air::Shadow& m_shadow;
    std::vector<AirDifference> m_rows;
};

}  // namespace

std::vector<AirDifference> differences(const air::Shadow& shadow, const Station& station) {
    const sim::Setup& sent = shadow.transmission().settings;
    const Programme& entered = station.programme;
    Rows rows(shadow);
    if (shadow.radio().pi) {
        const std::string pi = padded(entered.pi, kPiLength);
        rows.add("PI", entered.pi, ofChoice(Row::Pi, upperCase(pi), sent.pi), kPiLength);
        rows.add("PS", entered.psField, ofPs(entered.psField, sent.ps), kPsLength);
        rows.add("RT", entered.radiotext, ofRadiotext(entered.radiotext, sent), kRadiotextLength);
        rows.add("PTY", entered.pty, ofChoice(Row::Pty, entered.pty, std::to_string(sent.pty)));
        rows.add("TP", entered.trafficProgramme, ofChoice(Row::Tp, entered.trafficProgramme, flag(sent.tp)));
        rows.add("TA", entered.announcement, ofChoice(Row::Ta, entered.announcement, flag(sent.ta)));
        rows.add("MS", entered.musicSpeech,
                 ofChoice(Row::MusicSpeech, entered.musicSpeech, sent.musicSpeech == 1 ? "M" : "S"));
        rows.add("DI", entered.decoderInfo,
                 ofChoice(Row::DecoderInfo, entered.decoderInfo, std::to_string(sent.decoderInfo)));
    }
    // The panel counts its modes from 0 and sends that number, the coder counts from 1.
    const std::string& mode = station.multiplex.stereoMode;
    if (sent.stereoOn) rows.add("", mode, ofChoice(Row::StereoMode, mode, std::to_string(sent.stereoMode - 1)));
    return rows.take();
}

}  // namespace kdx
