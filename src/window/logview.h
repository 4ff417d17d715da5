#pragma once

#include <QDialog>

class QLineEdit;
class QPushButton;
class QSortFilterProxyModel;
class QTableView;

namespace kdx {

class Captions;
class TrafficLog;

/// The live view of the commands: each line as it is written, read or logged, with a filter and copying. Stays open
/// beside the main window.
class LogView : public QDialog {
    Q_OBJECT
public:
    LogView(TrafficLog& log, const Captions& captions, QWidget* parent);
    void label(const Captions& captions);

protected:
    void showEvent(QShowEvent* event) override;

private:
    void copy();
    void followEnd();

    TrafficLog& m_log;
    QLineEdit* m_filter = nullptr;
    QTableView* m_table = nullptr;
    QSortFilterProxyModel* m_filtered = nullptr;
    QPushButton* m_copy = nullptr;
    QPushButton* m_clear = nullptr;
    QPushButton* m_close = nullptr;
};

}  // namespace kdx
