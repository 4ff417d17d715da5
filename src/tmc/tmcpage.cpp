#include "tmc/tmcpage.h"

#include "tmc/tmcbuilder.h"
#include "tmc/tmctransmission.h"
#include "ui/layouts.h"

#include <QPushButton>

namespace kdx {

TmcPage::TmcPage(const PageContext& with, QWidget* parent) : Page(with, parent) {
    m_builder = new TmcBuilder(with, this);
    m_transmission = new TmcTransmission(with, *m_builder, this);
    layOut(this, column({m_builder, {m_transmission, 1}}), kPageMargin);  // room to spare goes to the message list
    named<QPushButton>("Command23", this)->hide();                        // belongs to the page, does nothing
}

void TmcPage::label() {
    m_builder->label();
    m_transmission->label();
}

void TmcPage::load() {
    m_builder->load();
    m_transmission->load();
    reloadLists();
}

void TmcPage::reloadLists() {
    m_builder->reloadLists();
}

}  // namespace kdx
