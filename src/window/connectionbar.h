#pragma once

#include <QWidget>

#include <string>

#include "ui/caption.h"
#include "ui/pagecontext.h"

class QGroupBox;
class QLabel;
class QPushButton;
class QScrollBar;

namespace kdx {

class ClickableLabel;

/// The upper edge of the window: which instrument, opening its session, the program's end, the banner.
class ConnectionBar : public QWidget {
    Q_OBJECT
public:
    ConnectionBar(const PageContext& with, QWidget* parent);

    void label() { m_book.label(m_with.captions); }
    /// Shows the interface in force and its stored address.
    void Schnittstellen_Toggle();
    /// Puts an interface (kGpibInterface or kLanInterface) in force and keeps it.
    void chooseInterface(const char* kind);
    /// Puts interface and address in force and keeps both.
    void use(const QString& kind, const QString& address);
    /// The address as it stands in the window.
    [[nodiscard]] std::string address() const;
    /// The same as the session was opened with.
    [[nodiscard]] QString openAddress() const;
    void showSessionOpen(bool open);
    /// Tells the connection in words.
    void showConnection(const QString& words);

signals:
    void openRequested();
    void endRequested();
    void interfaceShown(bool lan);

private:
    void Adr1_Label_Click();
    [[nodiscard]] bool onLan() const;

    PageContext m_with;
    CaptionBook m_book;
    QGroupBox* Frame8 = nullptr;  // connection
    QPushButton* INIT_Taste = nullptr;
    QScrollBar* Adr1_VScroll = nullptr;  // present without behaviour: the address is typed
    ClickableLabel* Adr1_Label = nullptr;
    QLabel* Label6 = nullptr;  // heading of a GPIB address
    QPushButton* Ende_Taste = nullptr;
    QLabel* Verbindung_Anzeige = nullptr;  // the connection in words
    QLabel* Image2 = nullptr;              // banner
};

}  // namespace kdx
