#include "onair/radiotables.h"

#include <QGroupBox>
#include <QHeaderView>
#include <QTableWidget>

#include <algorithm>

#include "af/othernetwork.h"
#include "air/receivercharacters.h"
#include "air/receivertrafficwords.h"
#include "air/shadow.h"
#include "base/codepage.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "coder/rdscharacters.h"
#include "onair/tables.h"
#include "onair/warningtexts.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "station/station.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

namespace {

// What came no more for so long is left out: two minutes is the longest that other networks may take (IEC 62106,
// 6.2.1.8), and a message that is cycled with others may take as long.
constexpr std::uint64_t kForgottenAfter = air::Ticks{std::chrono::minutes{2}} / air::kGroupTime;
constexpr std::size_t kMostMessages = 50;

QString megahertz(int kilohertz) {
    if (kilohertz < 80000) return QString::fromStdString(air::frequencyInWords(kilohertz));
    return QString::number(kilohertz / 1000.0, 'f', 1);
}

QString alternativesOf(const air::FrequencyList& list) {
    QStringList shown;
    for (const auto& alternative : list.alternatives)
        shown += megahertz(alternative.kilohertz) + (alternative.regional ? QStringLiteral(" (R)") : QString());
    return shown.join(QStringLiteral(", "));
}

QString frequenciesOf(const air::ReceivedNetwork& network) {
    QStringList shown;
    if (!network.frequencies.alternatives.empty()) shown += alternativesOf(network.frequencies);
    for (const auto& pair : network.mapped)
        shown += megahertz(pair.tuned) + QStringLiteral(" \u2192 ") + megahertz(pair.other);
    return shown.join(QStringLiteral(", "));
}

QTableWidget* tableIn(QGroupBox* frame, const char* name, int columns) {
    QTableWidget* table = newTable(name, columns, columns - 1, frame);
    layOut(frame, column({{table, 1}}), 2);
    return table;
}

}  // namespace

RadioTables::RadioTables(const PageContext& with, QWidget* parent)
    : QWidget(parent), m_with(with), m_texts(with.data.path()) {
    auto* frequencies = m_book.captioned<QGroupBox>("", {71}, this);
    Air_AF = tableIn(frequencies, "Air_AF", 3);
    auto* networks = m_book.captioned<QGroupBox>("", {738, "Andere Netze (EON)"}, this);
    Air_EON = tableIn(networks, "Air_EON", 6);
    auto* messages = m_book.captioned<QGroupBox>("", {740, "Verkehrsmeldungen (TMC)"}, this);
    Air_TMC = tableIn(messages, "Air_TMC", 5);
    Air_TMC->horizontalHeader()->setSectionResizeMode(0, QHeaderView::Stretch);
    m_book.spokenAs(Air_AF, frequencies);
    m_book.spokenAs(Air_EON, networks);
    m_book.spokenAs(Air_TMC, messages);
    auto* stack = column({{frequencies, 2}, {networks, 2}, {messages, 2}});
    layOut(this, stack, 0);
}

void RadioTables::label() {
    m_book.label(m_with.captions);
    Air_AF->setHorizontalHeaderLabels(
        {caption({735, "Methode"}), caption({736, "Sender [MHz]"}), caption({737, "Alternativen [MHz]"})});
    Air_EON->setHorizontalHeaderLabels({caption({725, "PI"}), caption({723, "PS"}), caption({726, "PTY"}),
                                        caption({727, "TP"}), caption({728, "TA"}), caption({739, "AF [MHz]"})});
    Air_TMC->setHorizontalHeaderLabels({caption({580, "Ereignis"}), caption({581, "Location"}),
                                        caption({579, "Ausdehnung"}), caption({201}), caption({745, "Weiteres"})});
}

void RadioTables::show(const air::Shadow& shadow, const Station& station) {
    showFrequencies(shadow);
    showNetworks(shadow, station);
    showMessages(shadow);
}

void RadioTables::showFrequencies(const air::Shadow& shadow) {
    std::vector<TableRow> rows;
    for (const air::FrequencyList& list : shadow.radio().frequencies) {
        rows.push_back({{list.methodB ? QStringLiteral("B") : QStringLiteral("A"),
                         list.methodB ? megahertz(list.tuned) : QString(), alternativesOf(list)}});
    }
    showRows(Air_AF, rows);
}

void RadioTables::showNetworks(const air::Shadow& shadow, const Station& station) {
    const air::RadioState& radio = shadow.radio();
    std::vector<TableRow> rows;
    const auto flag = [this](std::optional<bool> on) { return on ? caption({*on ? 192 : 193}) : QString(); };
    for (const air::ReceivedNetwork& network : radio.networks) {
        if (radio.groups - network.lastGroup > kForgottenAfter) continue;
        const QString pi = QString::fromStdString(hexDigits(network.pi, 4));
        const QString why = whyMarked(network, shadow, station.otherNetwork);
        const QString type = network.pty ? programmeType(static_cast<std::size_t>(*network.pty)) : QString();
        rows.push_back({{why.isEmpty() ? pi : QString(kDifferenceSign) + QLatin1Char(' ') + pi,
                         QString::fromStdString(air::shownText(network.ps)), type, flag(network.tp), flag(network.ta),
                         frequenciesOf(network)},
                        false,
                        why});
    }
    showRows(Air_EON, rows);
}

QString RadioTables::programmeType(std::size_t number) const {
    return toText(m_with.captions.programmeType(number));
}

/// Only the network that the page is about is one that something was entered for.
QString RadioTables::whyMarked(const air::ReceivedNetwork& network, const air::Shadow& shadow,
                               const OtherNetwork& entered) const {
    const std::string digits = hexDigits(network.pi, 4);
    if (!equalNoCase(entered.pi, digits)) return {};
    const std::string_view ps = std::string_view(entered.ps).substr(0, kPsLength);
    if (const auto character = withoutRdsCode(ps)) {
        return caption({794, "RDS kennt das Zeichen %1 nicht: das Radio zeigt ein Leerzeichen"})
            .arg(toText(std::string(1, *character)));
    }
    for (std::size_t i = 0; i < kPsLength; ++i) {
        if (network.ps.at(i) == rdsCode(i < ps.size() ? ps[i] : ' ')) continue;
        const QString shown = toText(entered.ps);
        return shadow.isRefused("EON-PS " + digits, ps) ? refusalText(ps, shown, m_with.captions, m_with.state)
                                                        : caption({790, "Eingegeben ist %1"}).arg(shown);
    }
    const auto differs = [](const std::string& flag, std::optional<bool> on) {
        return on && flag != (*on ? "1" : "0");
    };
    if (differs(entered.tp, network.tp))
        return caption({790, "Eingegeben ist %1"}).arg(QStringLiteral("TP ") + toText(entered.tp));
    if (differs(entered.ta, network.ta))
        return caption({790, "Eingegeben ist %1"}).arg(QStringLiteral("TA ") + toText(entered.ta));
    const std::string type = programmeTypeNumber(entered.pty, m_with.captions);
    if (type.empty() || type == std::to_string(network.pty.value_or(0))) return {};
    return withRemedy(caption({790, "Eingegeben ist %1"}).arg(programmeType(std::stoul(type))), &Corrections::eonType,
                      m_with.captions, m_with.state);
}

QStringList RadioTables::cellsOf(const air::TrafficMessage& message) {
    const auto text = [](const std::string& found, unsigned code) {
        return found.empty() ? QString::number(code) : toText(found);
    };
    QStringList more;
    if (message.diversion) more += caption({747, "Umleitung"});
    if (message.duration > 0) more += caption({746, "Dauer %1"}).arg(message.duration);
    if (message.multiGroup) more += caption({748, "mehrere Gruppen"});
    for (const auto& detail : message.details) more += QStringLiteral("%1: %2").arg(detail.label).arg(detail.value);
    return {text(m_texts.event(message.event), message.event),
            text(m_texts.location(message.location), message.location), QString::number(message.extent),
            caption({message.backward ? 203 : 202}), more.join(QStringLiteral(", "))};
}

void RadioTables::showMessages(const air::Shadow& shadow) {
    const air::RadioState& radio = shadow.radio();
    std::vector<TableRow> rows;
    if (radio.traffic.unannounced > 0 && !radio.traffic.group) {
        const QString why = caption({750, "8A ohne 3A: das Radio übergeht die Meldungen"});
        rows.push_back({{QString(kDifferenceSign) + QLatin1Char(' ') + why}, false, why});
    }
    const auto& messages = radio.traffic.messages;
    for (std::size_t i = messages.size() - std::min(messages.size(), kMostMessages); i < messages.size(); ++i) {
        if (radio.groups - messages[i].lastGroup <= kForgottenAfter) rows.push_back({cellsOf(messages[i].message)});
    }
    showRows(Air_TMC, rows);
}

QString RadioTables::text() const {
    return textOf(Air_AF) + QLatin1Char('\n') + textOf(Air_EON) + QLatin1Char('\n') + textOf(Air_TMC);
}

}  // namespace kdx
