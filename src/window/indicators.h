#pragma once

#include <QWidget>

#include "link/traffic.h"
#include "ui/pagecontext.h"

class QLabel;

namespace kdx {

class ClickableLabel;
class ConnectionBar;
class DataSets;

/// What the window tells beside the values: the set at work, whether there is an instrument at the other end, and
/// whether its RF output is on. The latter two are what its commands tell: one whose status says that nobody is
/// there any more means that the connection is lost, until the next one that succeeds.
class Indicators : public QObject, public TrafficWatcher {
    Q_OBJECT
public:
    /// @param simulated the instrument is the virtual one inside the program.
    Indicators(const PageContext& with, const DataSets& sets, ConnectionBar& bar, bool simulated, QObject* parent);
    ~Indicators() override;

    void label();
    void passed(const Traffic& traffic) override;
    void showSessionOpen(bool open);
    void showDataSet();

    ClickableLabel* Datensatz_Anzeige = nullptr;  // number of the set at work; a click shows all sets

private:
    enum class Output { Unknown, Off, On };

    void showConnection();
    void showOutput();
    [[nodiscard]] QString connection() const;

    PageContext m_with;
    const DataSets& m_sets;
    ConnectionBar& m_bar;
    bool m_simulated;
    bool m_open = false;
    bool m_lost = false;
    Output m_output = Output::Unknown;
    QLabel* m_setHeading = nullptr;
    QLabel* m_outputHeading = nullptr;
    QLabel* HF_Anzeige = nullptr;         // RF output on or off; "--" until it was switched
    QWidget* Verbindung_Marke = nullptr;  // the connection as a coloured dot
};

}  // namespace kdx
