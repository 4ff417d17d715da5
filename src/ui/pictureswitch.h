#pragma once

#include <QAbstractButton>
#include <QPixmap>

namespace kdx {

class DataFolder;

/// An on/off button that shows its state by the picture "Sch_On.ico" or "Sch_Off.ico" of the data folder; checked
/// while the on picture shows. A click changes nothing by itself: the handler decides and calls showState.
class PictureSwitch : public QAbstractButton {
    Q_OBJECT
public:
    PictureSwitch(const DataFolder& pictures, QWidget* parent);

    /// Loads and shows the picture of the state. A picture that cannot be loaded is replaced by a drawn one, so that
    /// the state is always to be seen.
    void showState(bool on);

    [[nodiscard]] QSize sizeHint() const override { return {36, 18}; }
    [[nodiscard]] QSize minimumSizeHint() const override { return sizeHint(); }

protected:
    void nextCheckState() override {}
    void paintEvent(QPaintEvent* event) override;

private:
    const DataFolder& m_data;
    QPixmap m_picture;
    bool m_pictureStale = true;
};

}  // namespace kdx
