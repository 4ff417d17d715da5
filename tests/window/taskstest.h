#pragma once

#include <memory>
#include <string>
#include <utility>

#include "link/workervisa.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "support/watchedvisa.h"
#include "support/windowtest.h"

namespace kdx::test {

/// The pages by their place.
constexpr int kStereoPage = 0;
constexpr int kRdsPage = 1;
constexpr int kAfPage = 2;
constexpr int kGroupPage = 3;
constexpr int kEonPage = 4;
constexpr int kQueryPage = 5;
constexpr int kStorePage = 6;
constexpr int kTmcPage = 7;
constexpr int kRfPage = 8;

/// A user before the whole window, on the shipped data, with the virtual instrument on the bench: its calls run in a
/// thread of their own as in the program. Only what can be seen and is enabled can be used.
class TasksTest : public WindowTest {
protected:
    void SetUp() override { startShipped(); }
    ~TasksTest() override { end(); }
    Visa& instrumentLink() override { return m_worker; }
    WorkerVisa* worker() override { return &m_worker; }

    void openSession();
    /// Opens the session and goes to a page.
    void workOn(int page);
    void showPage(int page);

    void click(QWidget& control);
    void click(const char* name) { click(*find(name)); }
    /// Types over what the entry holds; a line end is Return.
    static void type(QWidget& entry, const QString& text);
    void type(const char* name, const char* utf8) { type(*find(name), QString::fromUtf8(utf8)); }
    void choose(const char* entry);

    /// What the generator answers at the bench, without its line end; somebody else may also tell it something.
    std::string ask(const std::string& message);
    /// A value of the coder, without the quotes around it.
    std::string has(const std::string& name);
    /// The commands that have arrived since the last call.
    Lines got() { return std::exchange(m_got, {}); }

    sim::VirtualInstrument instrument{clock};
    sim::SimVisa bench{instrument};
    std::shared_ptr<WatchedVisa> cable = std::make_shared<WatchedVisa>(bench);

private:
    WorkerVisa m_worker{cable};
    Lines m_got;
};

}  // namespace kdx::test
