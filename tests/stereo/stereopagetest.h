#pragma once

#include <QGroupBox>
#include <QPushButton>
#include <QRadioButton>

#include "stereo/stereopage.h"
#include "support/pagetest.h"

namespace kdx::test {

/// Stands where the frame of the test mode does, with a button like its own; notes what it hears.
class FrameBelow : public Page {
public:
    explicit FrameBelow(const PageContext& with)
        : Page(with, nullptr), button(named<QPushButton>("Taste_DATA_MODE", this)) {
        setMinimumSize(button->sizeHint());
    }
    void label() override { heard.emplace_back("label"); }
    void load() override { heard.emplace_back("load"); }
    void opened() override { heard.emplace_back("opened"); }
    void stepGoesOut(const Step& step) override { heard.push_back(step.key + "=" + step.value); }

    QPushButton* button;
    Lines heard;
};

/// The page "FM / Stereo" with a frame on it where the test mode stands.
class StereoPageTest : public PageTest {
protected:
    QWidget& root() override { return page; }

    /// Does with the page what start-up does.
    void start() {
        multiplex.load(settings);
        page.load();
    }
    std::string general(const char* key) const { return profile("RDS_Allg.INI", "FM", key); }
    void setGeneral(const char* key, const char* value) { setProfile("RDS_Allg.INI", "FM", key, value); }
    int position(const char* name) { return find<QScrollBar>(name)->value(); }
    /// Index of the option that is chosen, -1 for none.
    int chosen(const std::string& array, int count) {
        for (int i = 0; i < count; ++i) {
            if (find<QRadioButton>((array + "_" + std::to_string(i)).c_str())->isChecked()) return i;
        }
        return -1;
    }

    Multiplex multiplex;
    FrameBelow* testMode = new FrameBelow(context);  // the page's
    StereoPage page{context, multiplex, testMode, nullptr};
};

}  // namespace kdx::test
