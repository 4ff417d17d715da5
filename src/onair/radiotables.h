#pragma once

#include <QWidget>

#include "onair/trafficlists.h"
#include "ui/caption.h"
#include "ui/pagecontext.h"

class QTableWidget;

namespace kdx {

struct OtherNetwork;
struct Station;
namespace air {
class Shadow;
struct ReceivedNetwork;
struct TrafficMessage;
}  // namespace air

/// What a radio lists: alternative frequencies, other networks, traffic messages in words.
class RadioTables : public QWidget {
public:
    RadioTables(const PageContext& with, QWidget* parent);

    void label();
    void show(const air::Shadow& shadow, const Station& station);
    /// The lists of events and locations were changed.
    void forgetTexts() { m_texts.forget(); }
    [[nodiscard]] QString text() const;

private:
    void showFrequencies(const air::Shadow& shadow);
    void showNetworks(const air::Shadow& shadow, const Station& station);
    void showMessages(const air::Shadow& shadow);
    [[nodiscard]] QString whyMarked(const air::ReceivedNetwork& network, const air::Shadow& shadow,
                                    const OtherNetwork& entered) const;
    [[nodiscard]] QStringList cellsOf(const air::TrafficMessage& message);
    [[nodiscard]] QString caption(const Caption& caption) const { return captionText(m_with.captions, caption); }
    [[nodiscard]] QString programmeType(std::size_t number) const;

    PageContext m_with;
    CaptionBook m_book;
    TrafficLists m_texts;
    QTableWidget* Air_AF = nullptr;
    QTableWidget* Air_EON = nullptr;
    QTableWidget* Air_TMC = nullptr;
};

}  // namespace kdx
