#pragma once

#include <string>
#include <vector>

namespace kdx {

class Captions;
class Instrument;
struct Corrections;

/// How an answer becomes the text that is shown. Texts are 8-bit Windows-1252; "" stands for a failed read.
namespace readback {

[[nodiscard]] std::string decoderInfo(const std::string& answer, const Captions& captions);
[[nodiscard]] std::string musicSpeech(const std::string& answer, const Captions& captions);
[[nodiscard]] std::string preemphasis(const std::string& answer, const Captions& captions);
[[nodiscard]] std::string impedance(const std::string& answer);
[[nodiscard]] std::string ariType(const std::string& answer, const Captions& captions);
/// "1" is caption 192 (on), "0" 193 (off), any other answer itself: a failed read leaves the place empty.
[[nodiscard]] std::string onOff(const std::string& answer, const Captions& captions);
/// Caption 21, ": ", the answer times 10 and " Hz"; "" for an empty answer.
[[nodiscard]] std::string deviation(const std::string& answer, const Captions& captions);

}  // namespace readback

/// One question of a read-back button: the name it is logged under and what is asked.
struct Query {
    std::string label;
    std::string key;
};

/// A read-back button: what it asks, and how the answers become the text that is shown.
struct ReadBack {
    const char* name;     ///< short, for who types it
    const char* meaning;  ///< what it asks for, in English
    const char* button;
    const char* design;  ///< caption where the language file has none
    int caption;         ///< its caption number
    bool generator;      ///< asks the generator itself, not the coder
    std::vector<Query> (*queries)(const std::string& eonIdentifier);
    std::string (*words)(const std::vector<std::string>& answers, const Captions& captions);
};

/// Asks the instrument all questions of the button. @param eonIdentifier PI of the other network at work.
/// @returns the answers in their order, "" for one that could not be read.
[[nodiscard]] std::vector<std::string> ask(Instrument& instrument, const ReadBack& readBack,
                                           const std::string& eonIdentifier);

/// The answers of the button as the text that is shown, as far as it is corrected.
[[nodiscard]] std::string wordsOf(const ReadBack& readBack, const std::vector<std::string>& answers,
                                  const Captions& captions, const Corrections& corrections);

/// All twenty buttons, in the order of their names.
[[nodiscard]] const std::vector<ReadBack>& readBacks();

}  // namespace kdx
