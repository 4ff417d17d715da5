#pragma once

#include <QLabel>

#include "ui/pagecontext.h"

class QAbstractItemModel;
class QListWidget;

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
    const QAbstractItemModel* m_entries;  ///< not the list: at its end it is none any more when they go
};

}  // namespace kdx
