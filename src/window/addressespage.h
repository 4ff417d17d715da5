#pragma once

#include <QStringList>
#include <QWidget>

#include <atomic>
#include <functional>
#include <string>
#include <thread>
#include <vector>

#include "ui/pagecontext.h"

class QLabel;
class QListWidget;
class QPushButton;

namespace kdx {

/// The page of the settings that lists instruments' addresses: the ones used before, and those found in the network.
/// An entry reads "TCPIP 192.168.0.7" or "IEC 28".
class AddressesPage : public QWidget {
    Q_OBJECT
public:
    /// Looks for instruments, gives up when the function it is handed says so; runs in a thread of its own.
    using Find = std::function<std::vector<std::string>(const std::function<bool()>& stopped)>;

    AddressesPage(const PageContext& with, Find find, QWidget* parent);
    ~AddressesPage() override;

    void label();
    void show(const QStringList& usedBefore);
    /// While a session is open its address stays.
    void showSessionOpen(bool open);

signals:
    void chosen(const QString& kind, const QString& address);
    /// A search has ended; said in its thread.
    void searched(const QStringList& addresses);

private:
    void Adressen_Suchen_Click();
    void Adressen_Verwenden_Click();
    void showFound(const QStringList& addresses);
    void showWhetherUsable();

    PageContext m_with;
    Find m_find;
    bool m_open = false;
    std::atomic<bool> m_stopped = false;
    std::thread m_search;
    QLabel* m_heading = nullptr;
    QListWidget* Adressen_Liste = nullptr;
    QPushButton* Adressen_Suchen = nullptr;
    QPushButton* Adressen_Verwenden = nullptr;
    QLabel* m_state = nullptr;  // what the search is at
};

}  // namespace kdx
