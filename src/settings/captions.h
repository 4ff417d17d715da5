#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace kdx {

class DataFolder;
class ProfileText;

/// How many programme types there are (IEC 62106, table of programme types).
inline constexpr int kProgrammeTypes = 32;

/// The language to speak. Before one was ever chosen it is the one the window was designed in.
[[nodiscard]] inline std::string languageOrDesign(const std::string& stored) {
    return stored.empty() ? "deutsch" : stored;
}

/// The caption table of the current language: every text by its number, as 8-bit Windows-1252 text.
class Captions {
public:
    explicit Captions(const DataFolder& data);

    /// Reads the language file anew. @param language section of that name ("deutsch", "english", "english US").
    /// @param standard "RDS" or "RBDS": which programme type names go with a language other than "deutsch".
    void load(const std::string& language, const std::string& standard);

    /// True when the file had no text at all for the language, or cannot be read.
    [[nodiscard]] bool isEmpty() const;

    /// The text of that number; "" where the file has none.
    [[nodiscard]] std::string text(int number) const;

    /// The text of one of the program's additional numbers (from 300 up); where the file has none the design text,
    /// which is UTF-8.
    [[nodiscard]] std::string own(int number, std::string_view design) const;

    /// Name of a programme type in the current language and standard; "" where the file has none.
    /// @param type 0 to 31. @throws std::out_of_range
    [[nodiscard]] std::string programmeType(std::size_t type) const;

private:
    const DataFolder& m_data;
    std::shared_ptr<const ProfileText> m_file;  // as loaded, whatever becomes of the file
    std::string m_language;
    std::string m_typeList;  ///< section with the names of the programme types
};

}  // namespace kdx
