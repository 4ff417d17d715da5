#include "window/addressespage.h"

#include <QLabel>
#include <QListWidget>
#include <QPushButton>

#include <exception>
#include <utility>

#include "ui/caption.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

AddressesPage::AddressesPage(const PageContext& with, Find find, QWidget* parent)
    : QWidget(parent), m_with(with), m_find(std::move(find)) {
    Adressen_Liste = named<QListWidget>("Adressen_Liste", this);
    connect(Adressen_Liste, &QListWidget::currentRowChanged, this, &AddressesPage::showWhetherUsable);
    connect(Adressen_Liste, &QListWidget::itemActivated, this, &AddressesPage::Adressen_Verwenden_Click);
    m_heading = new QLabel(this);
    m_heading->setBuddy(Adressen_Liste);
    Adressen_Suchen = named<QPushButton>("Adressen_Suchen", this);
    connect(Adressen_Suchen, &QPushButton::clicked, this, &AddressesPage::Adressen_Suchen_Click);
    Adressen_Verwenden = named<QPushButton>("Adressen_Verwenden", this);
    connect(Adressen_Verwenden, &QPushButton::clicked, this, &AddressesPage::Adressen_Verwenden_Click);
    for (QPushButton* button : {Adressen_Suchen, Adressen_Verwenden}) button->setAutoDefault(false);
    m_state = new QLabel(this);
    connect(this, &AddressesPage::searched, this, &AddressesPage::showFound, Qt::QueuedConnection);
    layOut(this, column({m_heading, {Adressen_Liste, 1}, row({Adressen_Suchen, m_state, kRoom, Adressen_Verwenden})}),
           kPageMargin);
    showWhetherUsable();
}

AddressesPage::~AddressesPage() {
    m_stopped = true;
    if (m_search.joinable()) m_search.join();
}

void AddressesPage::label() {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    m_heading->setText(text({930, "Früher benutzt oder im Netz gefunden"}));
    Adressen_Suchen->setText(text({931, "Im Netz &suchen"}));
    Adressen_Verwenden->setText(text({932, "&Verwenden"}));
    Adressen_Suchen->setToolTip(text({1143, "Fragt, welche Geräte im eigenen Netz antworten; nichts wird verstellt"}));
    for (QWidget* way : {static_cast<QWidget*>(Adressen_Liste), static_cast<QWidget*>(Adressen_Verwenden)}) {
        way->setToolTip(
            text({1144, "Macht den gewählten Eintrag zur Adresse, wie ein Doppelklick; nur ohne Verbindung"}));
    }
}

void AddressesPage::show(const QStringList& usedBefore) {
    Adressen_Liste->clear();
    Adressen_Liste->addItems(usedBefore);
    showWhetherUsable();
}

void AddressesPage::showSessionOpen(bool open) {
    m_open = open;
    showWhetherUsable();
}

void AddressesPage::Adressen_Suchen_Click() {
    Adressen_Suchen->setEnabled(false);
    m_state->setText(captionText(m_with.captions, {933, "Sucht..."}));
    if (m_search.joinable()) m_search.join();  // an earlier one, which has ended
    m_search = std::thread([this] {
        QStringList found;
        try {
            for (const std::string& address : m_find([this] { return m_stopped.load(); })) found += toText(address);
        } catch (const std::exception&) {
            found.clear();  // without a network there is nothing to be found
        }
        emit searched(found);
    });
}

void AddressesPage::showFound(const QStringList& addresses) {
    for (const QString& address : addresses) {
        const QString entry = QStringLiteral("TCPIP ") + address;
        if (Adressen_Liste->findItems(entry, Qt::MatchExactly).isEmpty()) Adressen_Liste->addItem(entry);
    }
    m_state->setText(addresses.isEmpty() ? captionText(m_with.captions, {946, "Nichts gefunden"}) : QString());
    Adressen_Suchen->setEnabled(true);
}

void AddressesPage::Adressen_Verwenden_Click() {
    const QListWidgetItem* entry = Adressen_Liste->currentItem();
    if (entry == nullptr || m_open) return;
    emit chosen(entry->text().section(QLatin1Char(' '), 0, 0), entry->text().section(QLatin1Char(' '), 1));
}

void AddressesPage::showWhetherUsable() {
    Adressen_Verwenden->setEnabled(!m_open && Adressen_Liste->currentItem() != nullptr);
}

}  // namespace kdx
