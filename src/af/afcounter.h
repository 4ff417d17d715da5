#pragma once

#include <QLabel>
#include <QListWidget>
#include <QPointer>

#include "ui/pagecontext.h"

namespace kdx {

/// Says how many AFs the shown list has and how many it may have, and keeps true while the list changes.
class AfCounter : public QLabel {
    Q_OBJECT
public:
    AfCounter(const PageContext& with, const QListWidget* list, QWidget* parent);

    /// Counts anew, in the current language.
    void count();

private:
    PageContext m_with;
    QPointer<const QListWidget> m_list;  ///< empties itself at the end, when it is none any more
};

}  // namespace kdx
