#include "window/datasets.h"

#include <QDir>
#include <QFileInfo>

#include "base/paths.h"
#include "rds/settings.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"
#include "settings/programstate.h"
#include "station/datasetfile.h"
#include "station/session.h"
#include "ui/caption.h"
#include "ui/dialogs.h"
#include "ui/text.h"

namespace kdx {

namespace fs = std::filesystem;

namespace {

fs::path pathOf(const QString& file) {
    return QFileInfo(file).filesystemAbsoluteFilePath();
}

bool isDataSet(const fs::path& file) {
    constexpr std::uintmax_t kMost = 10'000'000;  // bytes; a data set has some thousand
    std::error_code error;
    if (const auto size = fs::file_size(file, error); error || size > kMost) return false;
    const auto bytes = readFile(file);
    return bytes && !storedDataSet(ProfileText(*bytes)).empty();
}

QString shownFile(const fs::path& file) {
    return QString::fromStdString(utf8Of(file.filename()));
}

}  // namespace

void DataSets::choose(int number) {
    m_with.state.CurrentDataSet = std::to_string(number);
    m_with.state.openedFile.clear();
    load(setText(number));
}

void DataSets::open() {
    const QString answer = m_with.dialogs.fileToOpen(title(), caption({902, "Datensätze (*.INI *.ini)"}));
    if (answer.isEmpty()) return;
    const fs::path file = pathOf(answer);
    for (int set = 1; set <= kCount; ++set) {
        std::error_code error;
        if (fs::equivalent(file, m_with.data.file(dataSetFile(std::to_string(set))), error)) return choose(set);
    }
    // Looked at before it is read as settings are: a file that is none is no problem to be told from then on.
    if (!isDataSet(file)) {
        m_with.dialogs.message(Dialogs::Icon::Exclamation, title(),
                               caption({905, "In %1 ist kein Datensatz."}).arg(shownFile(file)));
        return;
    }
    m_with.state.openedFile = utf8Of(file);
    load(shownFile(file));
}

void DataSets::load(const QString& what) {
    m_with.state.dataSetChosen = true;
    m_session.loadDataSet();
    emit loaded();
    const QString question = caption({899, "%1 jetzt an das Gerät senden?"}).arg(what);
    if (m_session.instrument.isOpen() && m_with.dialogs.confirm(title(), question)) emit sendRequested();
}

void DataSets::saveAs(int number) {
    const std::string name = dataSetFile(std::to_string(number));
    const auto stored = m_with.data.profile(name);
    const bool taken = stored && !storedDataSet(*stored).empty();
    const QString what = setText(number) + QStringLiteral(" (%1)").arg(about(number));
    const QString question = caption({898, "%1 überschreiben?"}).arg(what);
    if (!taken || m_with.dialogs.confirmLoss(title(), question)) keep(m_with.data.file(name));
}

void DataSets::saveToFile() {
    // The box itself asks before a file is overwritten.
    const QString answer =
        m_with.dialogs.fileToSave(title(), QDir::home().filePath(QStringLiteral("%1.INI").arg(whatIsAtWork())),
                                  caption({902, "Datensätze (*.INI *.ini)"}));
    if (!answer.isEmpty()) keep(pathOf(answer));
}

void DataSets::keep(const fs::path& file) {
    const auto text = textAtWork();
    const DataSetContent content =
        dataSetAtWork(text ? *text : ProfileText(), m_session.station, m_with.state.corrections.edgeBlanks);
    if (!m_with.data.mayWrite(file) || !writeDataSet(content, file)) tellNotSaved(file);
}

void DataSets::rename() {
    const QString before = toText(m_with.profile.read(kDataSetName));
    const QString name = m_with.dialogs.input(caption({900, "Name von %1:"}).arg(whatIsAtWork()), title(), before);
    if (!name.isEmpty()) m_with.profile.write(kDataSetName, toBytes(name.trimmed()));
}

void DataSets::restore() {
    const QString question = caption({901, "%1 durch den ausgelieferten ersetzen?"}).arg(whatIsAtWork());
    if (!canBeRestored() || !m_with.dialogs.confirmLoss(title(), question)) return;
    const auto shipped = readFile(shippedFile());
    const fs::path file = m_with.data.file(fileAtWork());
    if (!shipped || !m_with.data.mayWrite(file) || !writeDataSet(storedDataSet(ProfileText(*shipped)), file))
        return tellNotSaved(file);
    load(whatIsAtWork());
}

int DataSets::number() const {
    return m_with.state.openedFile.empty() ? std::stoi(m_with.state.CurrentDataSet) : 0;
}

QString DataSets::shown() const {
    if (number() > 0) return QString::number(number());
    return shownFile(pathFromUtf8(m_with.state.openedFile));
}

QString DataSets::about(int number) const {
    // Not as settings are read: a set that nobody uses and that cannot be read is no problem to be told.
    const auto bytes = readFile(m_with.data.file(dataSetFile(std::to_string(number))));
    const ProfileText text(bytes.value_or(std::string()));
    const auto value = [&](const Place& place) { return toText(text.value(place.section, place.key)).trimmed(); };
    QStringList parts{value(setting::kPs.place), value(setting::kPi.place), value(kDataSetName)};
    parts.removeAll(QString());
    return parts.join(QStringLiteral("  "));
}

bool DataSets::canBeRestored() const {
    const fs::path file = shippedFile();
    std::error_code error;
    return !file.empty() && fs::is_regular_file(file, error) &&
           !fs::equivalent(file, m_with.data.file(fileAtWork()), error);
}

std::string DataSets::fileAtWork() const {
    return m_with.profile.fileOf(setting::kPs.place);
}

fs::path DataSets::shippedFile() const {
    return m_shipped.empty() || number() == 0 ? fs::path() : DataFolder(m_shipped).file(fileAtWork());
}

std::shared_ptr<const ProfileText> DataSets::textAtWork() const {
    return m_with.data.profile(fileAtWork());
}

QString DataSets::setText(int number) const {
    return caption({897, "Datensatz %1"}).arg(number);
}

QString DataSets::whatIsAtWork() const {
    return number() > 0 ? setText(number()) : shown();
}

QString DataSets::caption(const Caption& caption) const {
    return captionText(m_with.captions, caption);
}

QString DataSets::title() const {
    return caption({891, "&Datensatz"}).remove(QLatin1Char('&'));
}

void DataSets::tellNotSaved(const fs::path& file) {
    m_with.dialogs.message(Dialogs::Icon::Exclamation, title(),
                           caption({312, "Nicht gespeichert: %1"}).arg(shownFile(file)));
}

}  // namespace kdx
