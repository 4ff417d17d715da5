#pragma once

#include "groups/grouppage.h"

#include <gtest/gtest.h>

#include "support/pagetest.h"

namespace kdx::test {

/// The page "Gruppen" with its part of a data set.
class GroupPageTest : public PageTest {
protected:
    GroupPageTest() { page.label(); }
    QWidget& root() override { return page; }

    void press(std::initializer_list<int> groups) {
        for (const int number : groups) click(("Gruppe" + std::to_string(number)).c_str());
    }

    /// Start-up: the data set at work is read, then shown.
    void load() {
        part.load(settings);
        page.load();
    }

    GroupSequence part;
    GroupPage page{context, part, nullptr};
};

}  // namespace kdx::test
