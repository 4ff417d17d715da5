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
        connect(button, &QPushButton::clicked, this, [this, &readBack] { ask({&readBack}); });
        m_buttons.push_back(button);
    }
    m_shown = new QScrollArea(this);
    gelesen = captioned<QLabel>("gelesen", {139}, m_shown);
    m_shown->setWidget(gelesen);
    m_shown->setWidgetResizable(true);
    m_shown->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_shown->setFrameStyle(QFrame::NoFrame);
    m_book.spoken(m_shown, {139});
    gelesen->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    gelesen->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    gelesen->setWordWrap(true);
    gelesen->setMargin(6);
    QFont larger = font();
    larger.setPointSizeF(1.2 * larger.pointSizeF());  // read from a distance, with the hands at the instrument
    gelesen->setFont(larger);
    gelesen->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    m_shown->setMinimumHeight(gelesen->fontMetrics().lineSpacing() * 10 + 16);
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
    layOut(this, column({buttons, line(), {m_shown, 1}}), 8);
}

void QueryPage::label() {
    Page::label();
    if (!m_answers.empty()) showAnswers();
}

void QueryPage::Fragen_Schalter(bool on) {
    for (QPushButton* button : m_buttons) button->setEnabled(on);
}

void QueryPage::askAll() {
    std::vector<const ReadBack*> all;
    all.reserve(std::size(kOrder));
    for (const int index : kOrder) all.push_back(&readBacks()[static_cast<std::size_t>(index)]);
    ask(all);
}

void QueryPage::ask(const std::vector<const ReadBack*>& readBacks) {
    if (!m_with.state.InstrumentOnline) return;
    std::optional<CommandSequence> sequence;  // a single question is none
    if (readBacks.size() > 1 || readBacks.front()->queries(m_with.state.eonIdentifier).size() > 1) {
        sequence.emplace(m_with.instrument);
    }
    // Kept here while they come: a box of a failed question lets another button be pressed.
    std::vector<Answered> answers;
    for (const ReadBack* readBack : readBacks) {
        std::vector<std::string> answer = kdx::ask(m_with.instrument, *readBack, m_with.state.eonIdentifier);
        if (!answers.empty() && m_with.instrument.isSequenceStopped()) break;  // the rest was not asked
        answers.push_back({readBack, std::move(answer)});
    }
    m_answers = std::move(answers);
    showAnswers();
}

void QueryPage::showAnswers() {
    QStringList words;
    for (const auto& [asked, answers] : m_answers)
        words += toText(wordsOf(*asked, answers, m_with.captions, m_with.state.corrections));
    gelesen->setText(words.join(QLatin1Char('\n')));
}

}  // namespace kdx
