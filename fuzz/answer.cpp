// Answers of the instrument to the questions of the read-back buttons: bytes and statuses of any kind.
#include "harness.h"
#include "madeupvisa.h"

#include "coder/readback.h"
#include "link/instrument.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "support/fakeclock.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    kdx::fuzz::MadeUpVisa visa(input);
    kdx::ProgramState state;
    kdx::DataFolder files("/nonexistent");
    const kdx::Captions captions(files);
    kdx::test::FakeClock clock;
    kdx::Instrument instrument(visa, state, files, captions, clock);
    instrument.open("TCPIP", "127.0.0.1");

    const auto& buttons = kdx::readBacks();
    const kdx::ReadBack& button = buttons[input.ConsumeIntegralInRange<std::size_t>(0, buttons.size() - 1)];
    std::vector<std::string> answers;
    for (const kdx::Query& query : button.queries("D3C0")) {
        answers.push_back(button.generator ? instrument.VRN_Abfrage(query.label, query.key)
                                           : instrument.X4_Abfrage(query.label, query.key));
        demand(answers.back().find('\n') == std::string::npos, "an answer ends before its line end");
        demand(answers.back().size() <= kdx::kAnswerLength, "an answer is no longer than the buffer");
    }
    demand(button.words(answers, captions).size() < 2000, "the words are no longer than what was answered");
    const std::string read = instrument.ReadFromGen();
    demand(read.size() == kdx::kAnswerLength || read == kdx::kReadError, "a read gives 60 characters or fails");
    return 0;
}
