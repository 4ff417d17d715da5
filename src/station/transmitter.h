#pragma once

#include <cstddef>
#include <string>

#include "coder/step.h"

namespace kdx {

class Instrument;
class ParamSender;

/// Hears what a running sequence of steps does.
class StepWatcher {
public:
    virtual ~StepWatcher() = default;
    /// The step goes out now, as command `number` (from 1) of `total`; both 0 for a step that sends nothing.
    virtual void stepGoesOut(const Step& step, std::size_t number, std::size_t total) = 0;
    /// The sequence was stopped before this step.
    virtual void stepLeftOut(const Step& /*step*/) {}
    /// A question was answered: with the buffer as read, "Error" when the read failed.
    virtual void stepAnswered(const Step& step, const std::string& answer) = 0;
    /// The outermost sequence is over: sent, stopped, or ended by an exception.
    virtual void stepsEnded() = 0;
};

/// Takes steps to the instrument, one after the other.
class Transmitter {
public:
    Transmitter(Instrument& instrument, ParamSender& params) : m_instrument(instrument), m_params(params) {}

    /// Who is told; nobody with null. One at a time, lent.
    void setWatcher(StepWatcher* watcher) { m_watcher = watcher; }

    /// Runs the steps and reports each before it is sent. A sequence started from within another one belongs to it.
    /// @returns false when it was stopped: the rest has not been sent.
    bool run(Steps steps);
    /// Ends the running sequence before its next step.
    void stop();

private:
    class Run;

    void runStep(const Step& step);
    void askNetworks(Steps& steps, std::size_t at);

    Instrument& m_instrument;
    ParamSender& m_params;
    StepWatcher* m_watcher = nullptr;
    int m_depth = 0;  ///< how many sequences run within each other
};

}  // namespace kdx
