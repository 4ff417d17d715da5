// Lists of alternative frequencies as they are stored.
#include "harness.h"

#include "af/aflist.h"

#include <optional>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kdx;
    using fuzz::demand;
    FuzzedDataProvider input(data, size);
    const int number = input.ConsumeIntegralInRange(1, kAfLists);
    const std::string list = input.ConsumeRemainingBytesAsString();

    const std::size_t count = afCount(list);
    const std::optional<AfList> parts = splitForDisplay(list);
    demand(parts.has_value() == (count > 0), "a list is shown when it has an alternative");
    if (parts) {
        demand(joined(*parts) == list, "what was taken apart is put together the same");
        demand(parts->frequencies.size() == count, "each comma leads an alternative");
        for (const std::string& frequency : parts->frequencies) {
            demand(!isAlternativeFrequency(frequency) || isTunedFrequency(frequency), "its band lies within the other");
        }
    }
    demand(afValue(list, number, AfMethod::A) == newOrFurtherList(number) + list, "method A sends the list as it is");
    const auto pairs = afValue(list, number, AfMethod::B);
    demand(pairs.has_value() == (count <= kMostAfsOfMethodB), "method B has room for so many");
    demand(!pairs || afCount(*pairs) == 1 + 2 * count, "method B sends pairs");
    demand(withOneDecimal(list).size() <= std::max<std::size_t>(list.size(), 5), "a tuned frequency grows by no more");
    for (const std::string& frequency : pastedFrequencies(list)) {
        demand(isAlternativeFrequency(frequency), "what is pasted is allowed");
        demand(frequency.find(',') == std::string::npos, "a frequency is one entry");
    }
    return 0;
}
