// The language file.
#include "harness.h"

#include "base/codepage.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "support/tempfolder.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    const int number = input.ConsumeIntegral<std::uint16_t>();
    const std::string language = kdx::fuzz::nextText(input);
    const std::string standard = kdx::fuzz::nextText(input);
    const std::string design = kdx::fuzz::nextText(input);

    static const kdx::test::TempFolder folder;
    folder.write(kdx::kLanguageFile, input.ConsumeRemainingBytesAsString());
    const kdx::DataFolder files(folder.path());
    kdx::Captions captions(files);
    captions.load(language, standard);
    const std::string text = captions.text(number);
    demand(text.empty() || !captions.isEmpty(), "a language with a text is not empty");
    demand(captions.own(number, design) == (text.empty() ? kdx::fromUtf8(design) : text), "the file's text goes first");
    for (std::size_t type = 0; type < kdx::kProgrammeTypes; ++type) {
        demand(captions.programmeType(type).find_first_of("\r\n") == std::string::npos, "a name has one line");
    }
    return 0;
}
