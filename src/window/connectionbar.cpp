#include "window/connectionbar.h"

#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QScrollBar>

#include "base/numbers.h"
#include "link/resource.h"
#include "settings/generalsettings.h"
#include "settings/programstate.h"
#include "ui/clickablelabel.h"
#include "ui/dialogs.h"
#include "ui/elided.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr int kBannerWidth = 240;

/// On fine displays from the large picture, so that it is as sharp as they are.
QPixmap banner(qreal pixelRatio) {
    if (pixelRatio == 1) return QPixmap(QStringLiteral(":/banner.png"));
    QPixmap picture(QStringLiteral(":/banner@2x.png"));
    picture.setDevicePixelRatio(1);
    picture = picture.scaledToWidth(qRound(kBannerWidth * pixelRatio), Qt::SmoothTransformation);
    picture.setDevicePixelRatio(pixelRatio);
    return picture;
}

}  // namespace

ConnectionBar::ConnectionBar(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    Frame8 = named<QGroupBox>("Frame8", this);
    INIT_Taste = named<QPushButton>("INIT_Taste", QStringLiteral("IEC &Bus INIT"), Frame8);
    connect(INIT_Taste, &QPushButton::clicked, this, &ConnectionBar::openRequested);
    Label6 = m_book.captioned<QLabel>("Label6", {308, "Addr."}, Frame8);
    Adr1_Label = named<ClickableLabel>("Adr1_Label", Frame8);
    m_book.spoken(Adr1_Label, {319, "Adresse des Geräts"});
    Adr1_Label->setText(QStringLiteral("123.456.789.012"));
    Adr1_Label->setAlignment(Qt::AlignCenter);
    Adr1_Label->setMinimumWidth(Adr1_Label->fontMetrics().horizontalAdvance(QStringLiteral("000.000.000.000")) + 8);
    connect(Adr1_Label, &ClickableLabel::clicked, this, &ConnectionBar::Adr1_Label_Click);
    Label6->setBuddy(Adr1_Label);
    Adr1_VScroll = named<QScrollBar>("Adr1_VScroll", Qt::Vertical, Frame8);
    Ende_Taste = m_book.captioned<QPushButton>("Ende_Taste", {6}, this);
    connect(Ende_Taste, &QPushButton::clicked, this, &ConnectionBar::endRequested);
    Image2 = named<QLabel>("Image2", this);
    Image2->setPixmap(banner(devicePixelRatioF()));
    Image2->setAlignment(Qt::AlignRight | Qt::AlignVCenter);

    layOut(Frame8, row({INIT_Taste, Label6, Adr1_Label, Adr1_VScroll}));
    Verbindung_Anzeige = named<QLabel>("Verbindung_Anzeige", this);
    Verbindung_Anzeige->setSizePolicy(QSizePolicy::Ignored,
                                      QSizePolicy::Fixed);  // a host name may be long: see the tip
    elideLongText(*Verbindung_Anzeige);
    Verbindung_Anzeige->setMinimumWidth(
        Verbindung_Anzeige->fontMetrics().horizontalAdvance(QStringLiteral("verbunden: 000.000.000.000")));
    auto* state = column({row({Ende_Taste, kRoom}), Verbindung_Anzeige});
    state->setSpacing(1);
    auto* whole = row({Frame8, {state, 1}, Image2});
    whole->setSpacing(8);
    layOut(this, whole, 0);
}

bool ConnectionBar::onLan() const {
    return isLan(m_with.state.InterfaceKind);
}

void ConnectionBar::Schnittstellen_Toggle() {
    Adr1_VScroll->hide();
    Adr1_Label->setText(toText(m_with.profile.read(onLan() ? setting::kLanAddress : setting::kGpibAddress)));
    Adr1_Label->show();
    Label6->setVisible(!onLan());
    INIT_Taste->setText(onLan() ? QStringLiteral("Init TCPIP") : QStringLiteral("Init IEEE"));
    emit interfaceShown(onLan());
}

void ConnectionBar::chooseInterface(const char* kind) {
    m_with.state.InterfaceKind = kind;
    m_with.profile.write(setting::kInterface, kind);
    Schnittstellen_Toggle();
}

void ConnectionBar::use(const QString& kind, const QString& address) {
    const std::string name = toBytes(kind);
    m_with.profile.write(isLan(name) ? setting::kLanAddress : setting::kGpibAddress, toBytes(address));
    chooseInterface(name.c_str());
}

std::string ConnectionBar::address() const {
    return toBytes(Adr1_Label->text());
}

QString ConnectionBar::openAddress() const {
    return onLan() ? Adr1_Label->text() : QStringLiteral("GPIB ") + Adr1_Label->text();
}

void ConnectionBar::showConnection(const QString& words) {
    Verbindung_Anzeige->setText(words);
    Verbindung_Anzeige->setToolTip(words);
}

void ConnectionBar::Adr1_Label_Click() {
    const bool gpib = m_with.state.InterfaceKind == kGpibInterface;
    if (!gpib && !onLan()) return;
    const QString title = toText(m_with.state.InterfaceKind + " Adress.");
    QString typed = Adr1_Label->text();
    bool possible = true;
    do {
        typed = m_with.dialogs.input(QStringLiteral("Please enter here: "), title, typed);
        if (typed.isEmpty()) return;
        const double number = leadingNumber(toBytes(typed));
        possible = !gpib || (number > 1 && number < 31);  // 0, 1 and 31 cannot be entered: the program's own limit
    } while (!possible);
    Adr1_Label->setText(typed);
    m_with.profile.write(gpib ? setting::kGpibAddress : setting::kLanAddress, toBytes(typed));
}

void ConnectionBar::showSessionOpen(bool open) {
    for (QWidget* control : std::initializer_list<QWidget*>{Frame8, INIT_Taste, Ende_Taste}) control->setEnabled(!open);
}

}  // namespace kdx
