#include "af/afpage.h"

#include "af/afcounter.h"
#include "af/aflistenform.h"
#include "af/settings.h"
#include "settings/programstate.h"
#include "ui/dialogs.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"

namespace kdx {

AfPage::AfPage(const PageContext& with, AfListSet& lists, QWidget* parent) : Page(with, parent), m_lists(lists) {
    m_openEditor = [this] { AF_Listenform(m_with, window()).exec(); };
    create();
    arrange();
}

void AfPage::create() {
    Frame2 = captioned<QGroupBox>("Frame2", {71}, this);
    m_choice = captioned<QGroupBox>("", {440, "Auswahl"}, Frame2);
    m_shown = captioned<QGroupBox>("", {441, "Inhalt"}, Frame2);
    m_transmission = captioned<QGroupBox>("", {442, "Übertragung"}, Frame2);

    m_view.createOptions("AFList_Opt", 74, m_book, m_choice);
    m_view.options().onClick(this, &AfPage::AFList_Opt_Click);
    for (const Setting& list : setting::kAfLists)
        m_with.marks.watch(list.sendKey, this, [this](const Judgement&) { showMarks(); });
    AF_Bearbeiten = clicked<QPushButton>("AF_Bearbeiten", {72}, m_choice, &AfPage::AF_Bearbeiten_Click);
    m_view.createContent(named<QLabel>("AF_TN", m_shown), {443, "Sendefrequenz [MHz]"}, "AF_List1", {444, "AF [MHz]"},
                         m_book);
    AF_Zaehler = named<AfCounter>("AF_Zaehler", m_with, m_view.list(), m_shown);

    createOptions(AFMethod_opt, "AFMethod_opt", {{75}, {76}}, m_transmission, &AfPage::AFMethod_opt_Click);
    Taste_AF_Senden = clicked<QPushButton>("Taste_AF_Senden", {73}, m_transmission, &AfPage::Taste_AF_Senden_Click);
}

void AfPage::arrange() {
    layOut(m_choice, add(m_view.optionColumn(), {AF_Bearbeiten}));
    layOut(m_shown, add(m_view.contentColumn(), {AF_Zaehler}));
    layOut(m_transmission, add(column(AFMethod_opt), {kRoom, Taste_AF_Senden}));
    // Three equal columns in the order of the work: choose a list, look at it, send them all.
    layOut(Frame2, row({{m_choice, 1}, {m_shown, 1}, {m_transmission, 1}}));
    layOut(this, column({Frame2}), kPageMargin);
}

void AfPage::label() {
    Page::label();
    AF_Zaehler->count();
}

void AfPage::load() {
    const std::string shown = m_with.profile.read(setting::kShownAfList);
    m_view.chooseStored(shown.empty() ? "1" : shown);
    if (const int chosen = m_view.options().chosen(); chosen >= 0) showList(chosen);
    AFMethod_opt.choose(m_lists.method == AfMethod::B ? 1 : 0);
}

void AfPage::AFList_Opt_Click(int index) {
    m_with.profile.write(setting::kShownAfList, std::to_string(index + 1));
    showList(index);
}

void AfPage::AF_Bearbeiten_Click() {
    m_with.state.afEditorKind = kAfKind;
    m_openEditor();
    if (const int chosen = m_view.options().chosen(); chosen >= 0) AFList_Opt_Click(chosen);
}

void AfPage::Taste_AF_Senden_Click() {
    m_lists.load(m_with.profile);
    Steps steps;
    m_lists.appendSteps(steps);
    send(steps);
    judgeLists();  // not all may have gone out
}

void AfPage::AFMethod_opt_Click(int index) {
    m_lists.method = index == 1 ? AfMethod::B : AfMethod::A;
    judgeLists();
}

void AfPage::stepGoesOut(const Step& step) {
    if (step.kind != Step::Kind::Refused) return;
    for (int number = 1; number <= kAfLists; ++number) {
        if (step.key == setting::kAfLists.at(static_cast<std::size_t>(number) - 1).sendKey) refuse(number);
    }
}

void AfPage::refuse(int number) {
    // "english" alone counts as English here; "english US" gets the German text.
    const bool english = m_with.state.language == "english";
    m_with.dialogs.message(
        Dialogs::Icon::None,
        (english ? QStringLiteral("List Nr.%1 invalid") : QStringLiteral("Liste Nr.%1 ungültig")).arg(number),
        english ? QStringLiteral("It is not possible to transmit more than 12 AFs with Method B")
                : QStringLiteral("Es ist nicht möglich mehr als 12 AFs mit Methode B zu übertragen"));
}

void AfPage::showList(int index) {
    m_lists.load(m_with.profile);
    m_view.show(m_lists.lists.at(static_cast<std::size_t>(index)));
    judgeLists();
}

void AfPage::judgeLists() {
    for (std::size_t i = 0; i < m_lists.lists.size(); ++i) {
        const std::string& list = m_lists.lists[i];
        const char* const key = setting::kAfLists.at(i).sendKey;
        if (list.empty()) {
            m_with.marks.forget(key);
        } else {
            m_with.marks.shows(key, afValue(list, static_cast<int>(i) + 1, m_lists.method).value_or(list));
        }
    }
    showMarks();
}

void AfPage::showMarks() {
    const int chosen = m_view.options().chosen();
    m_view.mark(chosen < 0 ? Judgement{}
                           : m_with.marks.judge(setting::kAfLists.at(static_cast<std::size_t>(chosen)).sendKey));
    // The coder knows the method by the lists alone: by those it has.
    for (std::size_t i = 0; i < m_lists.lists.size(); ++i) {
        const auto value = afValue(m_lists.lists[i], static_cast<int>(i) + 1, m_lists.method);
        if (value && m_with.marks.has(setting::kAfLists.at(i).sendKey, *value)) m_sentMethod = m_lists.method;
    }
    const Judgement method = m_lists.method == m_sentMethod
                                 ? Judgement{}
                                 : Judgement{ValueState::Unsent, caption({857, "Noch nicht gesendet."})};
    for (std::size_t i = 0; i < AFMethod_opt.size(); ++i)
        showJudgement(*AFMethod_opt[i], static_cast<int>(i) == AFMethod_opt.chosen() ? method : Judgement{});
}

}  // namespace kdx
