#pragma once

#include <QGroupBox>
#include <QRadioButton>

#include "rds/testmode.h"
#include "stereo/stereopage.h"
#include "support/pagetest.h"

namespace kdx::test {

/// The page "FM / Stereo" with the frame of the test mode on it.
class StereoPageTest : public PageTest {
protected:
    QWidget& root() override { return page; }

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

    StereoPage page{context, new TestMode(context, nullptr), nullptr};
};

}  // namespace kdx::test
