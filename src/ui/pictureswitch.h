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
    /// Looks again for a picture that could not be loaded.
    void tryAgain();
    /// The file of the picture that it should show, when that is there but cannot be loaded; else "".
    [[nodiscard]] const QString& brokenPicture() const { return m_brokenPicture; }

    [[nodiscard]] QSize sizeHint() const override { return {36, 18}; }
    [[nodiscard]] QSize minimumSizeHint() const override { return sizeHint(); }

signals:
    void brokenPictureChanged();

protected:
    void nextCheckState() override {}
    void paintEvent(QPaintEvent* event) override;

private:
    void load();

    const DataFolder& m_data;
    QPixmap m_picture;
    QString m_brokenPicture;
    bool m_pictureStale = true;
};

}  // namespace kdx
