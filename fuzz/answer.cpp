// Answers of the instrument to the questions of the read-back buttons: bytes and statuses of any kind.
#include "harness.h"

#include "coder/readback.h"
#include "link/instrument.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "support/fakeclock.h"

#include <algorithm>

namespace {

using kdx::fuzz::demand;

/// An instrument that answers with the input's texts, one a question, and its statuses.
class MadeUpVisa final : public kdx::Visa {
public:
    explicit MadeUpVisa(FuzzedDataProvider& input) : m_input(input) {}
    kdx::VisaStatus viOpenDefaultRM(kdx::VisaHandle&) override { return kdx::visa::kSuccess; }
    kdx::VisaStatus viStatusDesc(kdx::VisaHandle, kdx::VisaStatus, std::string&) override { return nextStatus(); }
    kdx::VisaStatus viOpen(kdx::VisaHandle, const std::string&, std::uint32_t, std::uint32_t,
                           kdx::VisaHandle&) override {
        return kdx::visa::kSuccess;
    }
    kdx::VisaStatus viWrite(kdx::VisaHandle, std::span<const char>, std::int32_t&) override { return nextStatus(); }
    kdx::VisaStatus viRead(kdx::VisaHandle, std::span<char> buffer, std::int32_t& count) override {
        const std::string answer = m_input.ConsumeRandomLengthString(buffer.size());
        std::copy(answer.begin(), answer.end(), buffer.begin());
        count = static_cast<std::int32_t>(answer.size());
        return nextStatus();
    }
    kdx::VisaStatus viClose(kdx::VisaHandle) override { return nextStatus(); }

private:
    kdx::VisaStatus nextStatus() {
        return m_input.PickValueInArray({kdx::visa::kSuccess, kdx::visa::kMaxCountReached, kdx::visa::kTimeout});
    }

    FuzzedDataProvider& m_input;
};

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    MadeUpVisa visa(input);
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
