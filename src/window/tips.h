#pragma once

#include <QHash>
#include <QString>

class QWidget;

namespace kdx {

class Captions;

/// Tool tips for the controls of the window that have none of their own: what each sets and what its values mean.
class Tips {
public:
    /// Gives each of the window's controls its tip; one that the control was given elsewhere stays.
    void show(const QWidget& window, const Captions& captions);

private:
    QHash<const QWidget*, QString> m_shown;  ///< to know the own ones again
};

}  // namespace kdx
