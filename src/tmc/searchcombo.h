#pragma once

#include <QComboBox>

class QFrame;
class QLineEdit;
class QListView;

namespace kdx {

class FoundEntries;

/// A drop-down list of many entries that are searched as one types: any words of the entry, or its code. Typing opens
/// it too. Its box is named "NAME_Suche", the list of what was found "NAME_Treffer".
class SearchCombo : public QComboBox {
    Q_OBJECT
public:
    explicit SearchCombo(QWidget* parent);

    [[nodiscard]] QLineEdit* searchBox() const { return m_search; }
    /// Once the system's name of the box is known.
    void nameParts();

    void showPopup() override;
    void hidePopup() override;

protected:
    void keyPressEvent(QKeyEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void search(const QString& text);
    void choose(const QModelIndex& found);
    void place();

    FoundEntries* m_found = nullptr;
    QFrame* m_popup = nullptr;
    QLineEdit* m_search = nullptr;
    QListView* m_list = nullptr;
};

}  // namespace kdx
