#pragma once

#include <QPointer>

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "ui/controls.h"
#include "ui/valuestate.h"

class QWidget;

namespace kdx {

class Captions;
class Instrument;
class ParamSender;
struct ProgramState;

/// Marks the controls whose value the instrument does not have, whoever sent it: what went out under a key and did not
/// arrive, and what is shown without having been sent. A mark goes with the next command of its key that arrives.
/// Before the first session nothing is marked here.
class KeyMarks {
public:
    using Show = std::function<void(const Judgement&)>;

    KeyMarks(ParamSender& params, const Instrument& instrument, const ProgramState& state, const Captions& captions);
    ~KeyMarks();
    KeyMarks(const KeyMarks&) = delete;
    KeyMarks& operator=(const KeyMarks&) = delete;

    /// The control shows the value that goes out under the key. @param key outlives this.
    void add(const char* key, QWidget* control);
    /// Of the options the chosen one shows it.
    template <std::size_t Count>
    void add(const char* key, const OptionArray<Count>& options) {
        watch(key, options[0], [&options](const Judgement& judgement) {
            for (std::size_t i = 0; i < Count; ++i)
                showJudgement(*options[i], static_cast<int>(i) == options.chosen() ? judgement : Judgement{});
        });
    }
    /// Whoever shows it hears what is to be said of it, whenever that is or was anything.
    /// @param owner with which that ends.
    void watch(const char* key, const QObject* owner, Show show) { m_watches.push_back({key, owner, std::move(show)}); }

    /// What is to be said of the value that is shown for the key.
    [[nodiscard]] Judgement judge(std::string_view key) const;
    /// Whether what arrived last is the value.
    [[nodiscard]] bool has(std::string_view key, std::string value) const;
    /// A value is shown that did not come from sending it: it is in force only when it is what arrived last.
    void shows(const std::string& key, const std::string& value);
    /// A stopped sequence has left the value out.
    void leftOut(const std::string& key, const std::string& value);
    /// What went out last under a key is the value of another one.
    void sentUnder(const std::string& sendKey, const std::string& key);
    /// Nothing is known of the key's value any more.
    void forget(const std::string& key);
    /// Says all marks anew: the language or the tips have changed.
    void refresh();

private:
    struct State {
        std::string command;   ///< that went out last
        bool sent = false;     ///< there was one
        bool arrived = false;  ///< and the instrument has it
        bool other = false;    ///< a value is shown that makes another one

        [[nodiscard]] bool isMarked() const { return other || (sent && !arrived); }
    };
    struct Watch {
        std::string_view key;
        QPointer<const QObject> owner;
        Show show;
    };

    void wentOut(const std::string& key, const std::string& command, bool arrived);
    void set(const std::string& key, const State& state);
    void show(std::string_view key) const;

    ParamSender& m_params;
    const Instrument& m_instrument;
    const ProgramState& m_state;
    const Captions& m_captions;
    std::map<std::string, State, std::less<>> m_states;
    std::vector<Watch> m_watches;
};

}  // namespace kdx
