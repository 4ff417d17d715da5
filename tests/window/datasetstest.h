#pragma once

#include <gtest/gtest.h>

#include <string>

#include "support/windowtest.h"

namespace kdx::test {

class DataSetsTest : public WindowTest {
protected:
    DataSetsTest() { folder.copyShipped(); }
    void choose(int set) { action(("Mnu_Datensatz_" + std::to_string(set)).c_str())->trigger(); }
    std::string stored(int set, const std::string& key) const {
        return data.ReadIni("RDS", key, dataSetFile(std::to_string(set)));
    }
    std::string atLarge(const char* file, const std::string& key) const {
        return data.ReadIni("RDS", key, (folder.path() / file).string());
    }
    QString file(const char* name) const { return QString::fromStdString((folder.path() / name).string()); }
    /// A start that knows the folder the program was shipped with.
    void startWithShipped() {
        shipped = sourceFolder();
        start();
    }
};

}  // namespace kdx::test
