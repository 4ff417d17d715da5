#pragma once

#include <QObject>

#include <filesystem>
#include <memory>
#include <string>

#include "ui/pagecontext.h"

namespace kdx {

class ProfileText;
struct Caption;
struct Session;

/// What the user does with data sets as a whole: load one, keep what the window holds in another one or in any file,
/// name it, bring the shipped one back. Nothing is overwritten without a question.
class DataSets : public QObject {
    Q_OBJECT
public:
    static constexpr int kCount = 5;

    /// @param shipped the program's folder as it was shipped.
    DataSets(const PageContext& with, Session& session, const std::filesystem::path& shipped, QObject* parent)
        : QObject(parent), m_with(with), m_session(session), m_shipped(shipped) {}

    /// Loads the set, which is at work from then on, also for storing, and offers to send it.
    void choose(int number);
    /// The same with a file that holds one.
    void open();
    /// Keeps what the window holds as another set; the set at work stays.
    void saveAs(int number);
    void saveToFile();
    void rename();
    /// The set at work as it was shipped.
    void restore();

    /// Number of the set at work; 0 while a file is.
    [[nodiscard]] int number() const;
    /// What is at work in a few letters: the number, or the file's name.
    [[nodiscard]] QString shown() const;
    /// PS, PI and name of a set.
    [[nodiscard]] QString about(int number) const;
    /// Whether there is a shipped one of the set at work that is not the set itself.
    [[nodiscard]] bool canBeRestored() const;

signals:
    /// Another set is at work.
    void loaded();
    void sendRequested();

private:
    void load(const QString& what);
    void keep(const std::filesystem::path& file);
    [[nodiscard]] std::string fileAtWork() const;
    [[nodiscard]] std::filesystem::path shippedFile() const;
    [[nodiscard]] std::shared_ptr<const ProfileText> textAtWork() const;
    [[nodiscard]] QString setText(int number) const;
    [[nodiscard]] QString whatIsAtWork() const;
    [[nodiscard]] QString caption(const Caption& caption) const;
    [[nodiscard]] QString title() const;
    void tellNotSaved(const std::filesystem::path& file);

    PageContext m_with;
    Session& m_session;
    std::filesystem::path m_shipped;
};

}  // namespace kdx
