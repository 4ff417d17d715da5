#include "air/receivertrafficwords.h"

#include <string_view>

#include "air/receivercharacters.h"
#include "air/receiverfrequencies.h"
#include "base/numbers.h"

namespace kdx::air {

namespace {

std::string number(unsigned value) {
    return std::to_string(value);
}

std::string word(unsigned value) {
    return hexDigits(value, 4);
}

std::string yesNo(bool yes) {
    return yes ? "yes" : "no";
}

std::string vhf(unsigned code) {
    const int kilohertz = vhfKilohertz(code);
    return kilohertz == 0 ? "none" : frequencyInWords(kilohertz);
}

unsigned upper(std::uint16_t block) {
    return block >> 8U;
}

unsigned lower(std::uint16_t block) {
    return block & 0xFFU;
}

/// "event 1", and its text behind it when there is one.
std::string entry(const char* what, unsigned value, const std::function<std::string(unsigned)>& lookUp) {
    std::string words = std::string(what) + " " + number(value);
    const std::string text = lookUp ? lookUp(value) : std::string();
    return text.empty() ? words : words + " " + text;
}

/// Of the label 1 (ISO 14819-1, control codes).
std::string control(unsigned code) {
    constexpr std::array<std::string_view, 8> kCodes = {"urgency one step up",
                                                        "urgency one step down",
                                                        "direction the other way than the event's",
                                                        "duration of the other kind than the event's",
                                                        "duration spoken or not, other than the event's",
                                                        "with diversion",
                                                        "extent 8 more",
                                                        "extent 16 more"};
    return std::string(kCodes.at(code));
}

std::string length(unsigned code) {
    constexpr unsigned kByOne = 10;
    constexpr unsigned kByTwo = 15;
    if (code == 0) return "length above 100 km";
    const unsigned km = code <= kByOne   ? code
                        : code <= kByTwo ? kByOne + 2 * (code - kByOne)
                                         : 20 + 5 * (code - kByTwo);
    return "length " + number(km) + " km";
}

/// A time of the labels 7 and 8: quarters of an hour, then hours of the next days, days of the month, half months.
std::string time(unsigned code) {
    constexpr unsigned kHours = 96;
    constexpr unsigned kDays = 201;
    constexpr unsigned kMonths = 232;
    const auto digits = [](unsigned value) { return twoDigits(static_cast<int>(value)); };
    if (code < kHours) return digits(code / 4) + ":" + digits(code % 4 * 15);
    if (code < kDays) return digits((code - kHours) % 24) + ":00, days later " + number((code - kHours) / 24);
    if (code < kMonths) return "day of the month " + number(code - kDays + 1);
    const bool end = (code - kMonths) % 2 == 1;
    return std::string(end ? "end" : "middle") + " of month " + number((code - kMonths) / 2 + 1);
}

/// A field of the optional content, by its label (ISO 14819-1).
std::string detailInWords(const TrafficMessage::Detail& detail, const TrafficTexts& texts) {
    const auto& [label, value] = detail;
    switch (label) {
        case 0:
            return "duration " + number(value);
        case 1:
            return control(value);
        case 2:
            return length(value);
        case 3:
            return "speed limit " + number(5 * value) + " km/h";
        case 4:
        case 5:
            return "quantity " + number(value);
        case 6:
            return "supplementary information " + number(value);
        case 7:
            return "from " + time(value);
        case 8:
            return "until " + time(value);
        case 9:
            return entry("also event", value, texts.event);
        case 10:
            return entry("diversion by location", value, texts.location);
        case 11:
            return entry("destination location", value, texts.location);
        case 13:
            return entry("caused at location", value, texts.location);
        case 14:
            return "separator";
        default:
            return "label " + number(label) + " (reserved)";
    }
}

std::string several(unsigned continuity) {
    return "traffic message of several groups, continuity index " + number(continuity) + ", ";
}

std::string furtherInWords(const TrafficGroup& group) {
    return several(group.continuity) + (group.second ? "second group" : "further group") + ", " +
           number(group.toFollow) + " to follow, content " + hexDigits(group.content, 7) + ", F 0, T 0";
}

/// Tuning information (ISO 14819-1): who else has the service, and where.
std::string tuningInWords(const TrafficGroup& group) {
    const std::uint16_t y = group.block3;
    const std::uint16_t z = group.block4;
    switch (group.variant) {
        case 4:
        case 5: {
            const std::array<std::uint8_t, 4> codes = {
                static_cast<std::uint8_t>(upper(y)), static_cast<std::uint8_t>(lower(y)),
                static_cast<std::uint8_t>(upper(z)), static_cast<std::uint8_t>(lower(z))};
            return std::string(group.variant == 4 ? "first" : "second") + " half of the provider's name \"" +
                   shownText(codes) + "\"";
        }
        case 6:
            return "network " + word(z) + " on " + vhf(upper(y)) + ", " + vhf(lower(y));
        case 7:
            return "network " + word(z) + " on " + vhf(lower(y)) + " where this one is on " + vhf(upper(y));
        case 8:
            return "networks " + word(y) + ", " + word(z);
        case 9:
            return "network " + word(z) + " with location table " + number(y >> 10U) + ", scope " +
                   hexDigits(y >> 6U & 0xFU, 1) + ", service " + number(y & 0x3FU);
        default:
            return word(y) + " " + word(z);
    }
}

std::string scopeInWords(const TrafficTable& table) {
    std::string scope;
    if (table.international) scope += " international";
    if (table.national) scope += " national";
    if (table.regional) scope += " regional";
    if (table.urban) scope += " urban";
    return scope.empty() ? " none" : scope;
}

std::string systemInformation(const OpenDataAnnouncement& announcement) {
    if (const auto table = announcement.table()) {
        return "location table " + number(table->number) + (table->number == 0 ? " (encrypted)" : "") +
               ", alternative frequencies " + yesNo(table->alternativeFrequencies) + ", enhanced mode " +
               yesNo(table->enhanced) + ", scope" + scopeInWords(*table);
    }
    if (const auto timing = announcement.timing()) {
        return "gap of " + number(timing->gap) + " groups, service " + number(timing->service) + ", activity " +
               number(timing->activity) + " s, window " + number(timing->window) + " s, delay " +
               number(timing->delay) + " s";
    }
    if (const auto country = announcement.country()) {
        return "location table country " + hexDigits(country->country, 1) + ", extended country code " +
               hexDigits(country->extended, 2);
    }
    return "variant " + number(announcement.variant());
}

std::string groupName(const OpenDataAnnouncement& announcement) {
    if (announcement.group == 0) return "no group of its own";
    if (announcement.comesInNoGroup()) return "no group for now (fault)";
    return "group " + number(announcement.group >> 1U) + ((announcement.group & 1U) == 0 ? "A" : "B");
}

}  // namespace

std::string frequencyInWords(int kilohertz) {
    constexpr int kVhf = 80000;
    if (kilohertz < kVhf) return std::to_string(kilohertz) + " kHz";
    return std::to_string(kilohertz / 1000) + "." + std::to_string(kilohertz / 100 % 10) + " MHz";
}

std::string inWords(const TrafficMessage& message, const TrafficTexts& texts) {
    std::string words = entry("event", message.event, texts.event) + ", " +
                        entry("location", message.location, texts.location) + ", extent " + number(message.extent) +
                        ", direction " + (message.backward ? "backward" : "forward");
    if (!message.multiGroup) {
        words += ", duration " + number(message.duration) + ", " + (message.diversion ? "diversion" : "no diversion");
    }
    for (const TrafficMessage::Detail& detail : message.details) words += ", " + detailInWords(detail, texts);
    return words;
}

std::string inWords(const TrafficGroup& group, const TrafficTexts& texts) {
    switch (group.kind) {
        case TrafficGroup::Kind::Single:
            return "traffic message: " + inWords(group.message, texts) + ", F 1, T 0";
        case TrafficGroup::Kind::First:
            return several(group.continuity) + "first group: " + inWords(group.message, texts) + ", F 0, T 0";
        case TrafficGroup::Kind::Further:
            return furtherInWords(group);
        case TrafficGroup::Kind::Tuning:
            return "tuning information for traffic messages, variant " + number(group.variant) + ": " +
                   tuningInWords(group) + ", T 1";
        case TrafficGroup::Kind::Administration:
            return "administration of encrypted traffic messages: " + word(group.block3) + " " + word(group.block4) +
                   ", F 0, T 0";
        case TrafficGroup::Kind::Unknown:
            break;
    }
    return "traffic message of several groups with the reserved continuity index 7, F 0, T 0";
}

std::string inWords(const OpenDataAnnouncement& announcement) {
    const std::string words =
        "open data in " + groupName(announcement) + ", application " + word(announcement.application);
    return announcement.isTraffic() ? words + " (traffic messages), " + systemInformation(announcement) : words;
}

}  // namespace kdx::air
