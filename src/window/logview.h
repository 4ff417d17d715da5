#pragma once

#include <QDialog>

#include "ui/pagecontext.h"

class QLineEdit;
class QPushButton;
class QSortFilterProxyModel;
class QTableView;

namespace kdx {

class TrafficLog;

/// The live view of the commands: each line as it is written, read or logged, with a filter, a pause, copying and
/// saving. Stays open beside the main window.
class LogView : public QDialog {
    Q_OBJECT
public:
    LogView(TrafficLog& log, const PageContext& with, QWidget* parent);
    ~LogView() override;
    void label();

protected:
    void showEvent(QShowEvent* event) override;

private:
    void Log_Umbruch_Click(bool wrapped);
    void Log_Sichern_Click();
    void copy();
    void fit(int first, int last);
    /// The lines, of all that is shown unless given.
    [[nodiscard]] QString text(QList<int> rows = {}) const;

    TrafficLog& m_log;
    PageContext m_with;
    QLineEdit* Log_Filter = nullptr;
    QTableView* Log_Liste = nullptr;
    QSortFilterProxyModel* m_filtered = nullptr;
    QPushButton* Log_Pause = nullptr;
    QPushButton* Log_Umbruch = nullptr;
    QPushButton* Log_Sichern = nullptr;
    QPushButton* m_copy = nullptr;
    QPushButton* m_clear = nullptr;
    QPushButton* m_close = nullptr;
    bool m_follows = true;
};

}  // namespace kdx
