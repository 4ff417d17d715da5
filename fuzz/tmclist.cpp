// Event and location lists: every line with a semicolon is an entry, and adding, changing or deleting one leaves the
// others as they were. The kept message list comes back as it was kept.
#include "harness.h"

#include "settings/withoutcontrols.h"
#include "support/tempfolder.h"
#include "tmc/groupcode.h"
#include "tmc/messagefile.h"
#include "tmc/tmclist.h"

#include <algorithm>
#include <cmath>

namespace {

using kdx::fuzz::demand;

std::vector<std::string> entriesOf(const std::filesystem::path& file) {
    const auto list = kdx::loadTmcList(file);
    demand(list.has_value(), "a list can be read whatever is in it");
    std::vector<std::string> entries;
    for (std::size_t index = 0; index < list->size(); ++index) entries.push_back((*list)[index]);
    return entries;
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    const std::string text = kdx::withoutControls(kdx::fuzz::nextText(input));
    const std::string code = kdx::withoutControls(kdx::fuzz::nextText(input));
    const std::string bytes = input.ConsumeRemainingBytesAsString();

    static const kdx::test::TempFolder folder;
    folder.write("Event.txt", bytes);
    const auto file = folder.data() / "Event.txt";
    const auto entries = entriesOf(file);
    const auto lines = kdx::fuzz::split(bytes, "\n");
    const auto entryLines = std::count_if(
        lines.begin(), lines.end(), [](std::string_view line) { return line.find(';') != std::string_view::npos; });
    demand(entries.size() == static_cast<std::size_t>(entryLines), "every line with a semicolon is an entry");
    for (const std::string& entry : entries) {
        demand(entry.size() >= kdx::kListTextLength, "an entry is as wide as its column");
        demand(!std::isnan(kdx::entryNumber(entry)), "an entry ends in a number, or in none");
    }

    demand(kdx::appendToTmcList(file, text, code), "an entry can be added");
    auto expected = entries;
    expected.push_back(kdx::shownEntry(text + ";" + code).value());
    demand(entriesOf(file) == expected, "the added entry comes last and the others stay");

    const std::size_t at = expected.size() / 2;
    const std::string line(kdx::loadTmcList(file)->line(at));
    demand(kdx::changeInTmcList(file, at, line, text, code), "an entry can be changed");
    expected[at] = kdx::shownEntry(text + ";" + code).value();
    demand(entriesOf(file) == expected, "the changed entry stands in its place and the others stay");
    const std::string changed(kdx::loadTmcList(file)->line(at));
    demand(kdx::removeFromTmcList(file, at, changed), "an entry can be deleted");
    expected.erase(expected.begin() + static_cast<std::ptrdiff_t>(at));
    demand(entriesOf(file) == expected, "the others stay");

    folder.write("TMC_Liste.txt", bytes);
    const auto messages = kdx::loadMessages(folder.data() / "TMC_Liste.txt");
    demand(kdx::storeMessages(folder.data() / "TMC_Liste.txt", messages), "messages can be kept");
    demand(kdx::loadMessages(folder.data() / "TMC_Liste.txt") == messages, "kept messages come back");
    return 0;
}
