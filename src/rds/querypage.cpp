#include "rds/querypage.h"

#include <array>
#include <optional>
#include <utility>

#include "coder/readback.h"
#include "link/commandsequence.h"
#include "settings/programstate.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr int kColumns = 5;

// The buttons by what they ask about, row by row, as indexes into readBacks(): programme, traffic and time, networks
// and lists, multiplex, generator. A line separates the coder's data from the signal.
constexpr int kCoderRows = 2;
constexpr std::array kOrder = {2,  3,  4,  17, 18,   // PS, PI, PTY, M/S, DI
                               5,  6,  1,  16, 14,   // RT, time, AF, EON, groups
                               13, 0,  11, 12, 8,    // RDS, ARI, pilot, stereo mode, FM deviation
                               9,  10, 15, 7,  19};  // source, pre-emphasis, impedance, frequency, level

}  // namespace

QueryPage::QueryPage(const PageContext& with, QWidget* parent) : Page(with, parent) {
    create();
    arrange();
}

void QueryPage::create() {
    for (const ReadBack& readBack : readBacks()) {
        auto* button = captioned<QPushButton>(readBack.button, {readBack.caption, readBack.design}, this);
        connect(button, &QPushButton::clicked, this, [this, &readBack] { ask(readBack); });
        m_buttons.push_back(button);
    }
    gelesen = captioned<QLabel>("gelesen", {139}, this);
    gelesen->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    gelesen->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    gelesen->setWordWrap(true);
    gelesen->setMargin(6);
    gelesen->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    QFont larger = font();
    larger.setPointSizeF(1.2 * larger.pointSizeF());  // read from a distance, with the hands at the instrument
    gelesen->setFont(larger);
    gelesen->setMinimumHeight(gelesen->fontMetrics().lineSpacing() * 10 + 16);
}

void QueryPage::arrange() {
    const auto line = [this] {
        auto* separator = new QFrame(this);
        separator->setFrameStyle(QFrame::HLine | QFrame::Sunken);
        return separator;
    };
    auto* buttons = grid({});
    int lines = 0;
    int across = 0;
    QWidget* previous = nullptr;
    for (const int index : kOrder) {
        QPushButton* button = m_buttons[static_cast<std::size_t>(index)];
        buttons->addWidget(button, lines, across);
        if (previous != nullptr) setTabOrder(previous, button);
        previous = button;
        if (++across < kColumns) continue;
        across = 0;
        if (++lines == kCoderRows) buttons->addWidget(line(), lines++, 0, 1, kColumns);
    }
    layOut(this, column({buttons, line(), {gelesen, 1}}), 8);
}

void QueryPage::label() {
    Page::label();
    if (m_asked != nullptr) showAnswers();
}

void QueryPage::Fragen_Schalter(bool on) {
    for (QPushButton* button : m_buttons) button->setEnabled(on);
}

void QueryPage::ask(const ReadBack& readBack) {
    if (!m_with.state.InstrumentOnline) return;
    std::optional<CommandSequence> sequence;  // a single question is none
    if (readBack.queries(m_with.state.eonIdentifier).size() > 1) sequence.emplace(m_with.instrument);
    // Kept here while they come: a box of a failed question lets another button be pressed.
    std::vector<std::string> answers = kdx::ask(m_with.instrument, readBack, m_with.state.eonIdentifier);
    m_answers = std::move(answers);
    m_asked = &readBack;
    showAnswers();
}

void QueryPage::showAnswers() {
    gelesen->setText(toText(wordsOf(*m_asked, m_answers, m_with.captions, m_with.state.corrections)));
}

}  // namespace kdx
