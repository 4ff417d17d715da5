#pragma once

#include <QButtonGroup>
#include <QRadioButton>
#include <QScrollBar>
#include <QSignalBlocker>
#include <QStringList>

#include <array>
#include <cstddef>

#include "ui/named.h"

namespace kdx {

/// Arial, its metric twin, and what there is without both. One list for all: a font with another one is looked up and
/// loaded anew.
[[nodiscard]] inline QStringList arialFamilies() {
    return {QStringLiteral("Arial"), QStringLiteral("Liberation Sans"), QStringLiteral("DejaVu Sans")};
}

/// A control array of option buttons: one of them at most is chosen.
template <std::size_t Count>
class OptionArray {
public:
    /// Makes the buttons in a group of their own; name and element number are their object names.
    void create(const char* name, QWidget* parent) {
        m_group = new QButtonGroup(parent);
        for (std::size_t i = 0; i < Count; ++i) {
            m_options[i] = element<QRadioButton>(name, i, parent);
            m_group->addButton(m_options[i], static_cast<int>(i));
        }
    }
    /// Runs the receiver's handler with the option's index at every click on one.
    template <typename Receiver>
    void onClick(Receiver* receiver, void (Receiver::*handler)(int)) const {
        for (std::size_t i = 0; i < Count; ++i) {
            QObject::connect(m_options[i], &QRadioButton::clicked, receiver,
                             [receiver, handler, i] { (receiver->*handler)(static_cast<int>(i)); });
        }
    }
    [[nodiscard]] QRadioButton* operator[](std::size_t i) const { return m_options.at(i); }
    [[nodiscard]] auto begin() const { return m_options.begin(); }
    [[nodiscard]] auto end() const { return m_options.end(); }
    [[nodiscard]] static constexpr std::size_t size() { return Count; }
    /// Index of the chosen option, -1 when none is.
    [[nodiscard]] int chosen() const { return m_group->checkedId(); }
    /// Chooses an option without running its handler; an index outside the array leaves none chosen.
    void choose(int index) {
        m_group->setExclusive(false);
        for (std::size_t i = 0; i < Count; ++i) {
            const QSignalBlocker quiet(m_options[i]);
            const bool chosen = static_cast<int>(i) == index;
            m_options[i]->setChecked(chosen);
            // The tab key goes to the chosen option, or to the first one where none is chosen.
            const bool first = i == 0 && (index < 0 || index >= static_cast<int>(Count));
            m_options[i]->setFocusPolicy(chosen || first ? Qt::StrongFocus : Qt::ClickFocus);
        }
        m_group->setExclusive(true);
    }

private:
    QButtonGroup* m_group = nullptr;
    std::array<QRadioButton*, Count> m_options{};
};

/// Sets a scroll bar without running its change handler; the value is kept within its range.
inline void setQuietly(QScrollBar* bar, int value) {
    const QSignalBlocker quiet(bar);
    bar->setValue(value);
}

}  // namespace kdx
