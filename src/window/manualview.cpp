#include "window/manualview.h"

#include <QDir>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollBar>
#include <QShortcut>
#include <QTextBlock>
#include <QTextBrowser>
#include <QTextTable>

#include <utility>

#include "base/paths.h"
#include "settings/programstate.h"
#include "ui/layouts.h"

namespace kdx {

namespace {

/// The reader of Markdown leaves tables without room in their cells.
void fitTables(const QTextDocument& text) {
    for (QTextFrame* frame : text.rootFrame()->childFrames()) {
        auto* table = qobject_cast<QTextTable*>(frame);
        if (table == nullptr) continue;
        QTextTableFormat format = table->format();
        format.setCellPadding(kGap);
        format.setCellSpacing(0);
        format.setBorder(1);
        format.setBorderCollapse(true);
        table->setFormat(format);
    }
}

/// Reads Markdown apart from what is shown: a long table that grows row by row in sight takes seconds.
class ManualText final : public QTextBrowser {
public:
    using QTextBrowser::QTextBrowser;

protected:
    QVariant loadResource(int type, const QUrl& name) override {
        QVariant loaded = QTextBrowser::loadResource(type, name);
        if (type != QTextDocument::HtmlResource) return loaded;
        QTextDocument chapter;
        chapter.setDefaultFont(font());
        chapter.setMarkdown(QString::fromUtf8(loaded.toByteArray()));
        fitTables(chapter);
        return chapter.toHtml();
    }
    void doSetSource(const QUrl& name, QTextDocument::ResourceType /*type*/) override {
        QTextBrowser::doSetSource(name, QTextDocument::HtmlResource);
    }
};

bool holdsPicture(const QTextBlock& block, const QString& name) {
    for (auto part = block.begin(); !part.atEnd(); ++part) {
        const QTextCharFormat format = part.fragment().charFormat();
        if (format.isImageFormat() && QFileInfo(format.toImageFormat().name()).fileName() == name) return true;
    }
    return false;
}

}  // namespace

ManualView::ManualView(std::filesystem::path folder, const PageContext& with, QWidget* parent)
    : QDialog(parent), m_folder(std::move(folder)), m_with(with) {
    setObjectName(QStringLiteral("ManualView"));
    Handbuch_Text = named<ManualText>("Handbuch_Text", this);
    connect(Handbuch_Text, &QTextBrowser::sourceChanged, this, [this] { Handbuch_Stand->clear(); });
    const auto button = [this](const char* name, const Caption& caption, auto* receiver, auto handler) {
        auto* made = m_book.captioned<QPushButton>(name, caption, this);
        made->setAutoDefault(false);  // Return searches
        connect(made, &QPushButton::clicked, receiver, handler);
        return made;
    };
    Handbuch_Zurueck = button("Handbuch_Zurueck", {1111, "&Zurück"}, Handbuch_Text, &QTextBrowser::backward);
    Handbuch_Vor = button("Handbuch_Vor", {1112, "&Vor"}, Handbuch_Text, &QTextBrowser::forward);
    for (QPushButton* way : {Handbuch_Zurueck, Handbuch_Vor}) way->setEnabled(false);
    connect(Handbuch_Text, &QTextBrowser::backwardAvailable, Handbuch_Zurueck, &QWidget::setEnabled);
    connect(Handbuch_Text, &QTextBrowser::forwardAvailable, Handbuch_Vor, &QWidget::setEnabled);
    Handbuch_Inhalt = button("Handbuch_Inhalt", {1113, "&Inhalt"}, this, [this] { openAt({}); });
    for (QPushButton* way : {Handbuch_Zurueck, Handbuch_Vor, Handbuch_Inhalt})
        m_book.tip(way, {1142, "Zurück und Vor: Kapitel, die schon offen waren; Inhalt: alle Kapitel"});
    Handbuch_Suche = named<QLineEdit>("Handbuch_Suche", this);
    Handbuch_Suche->setClearButtonEnabled(true);
    m_book.describe(Handbuch_Suche, {1114, "Im Kapitel suchen"});
    connect(Handbuch_Suche, &QLineEdit::returnPressed, this, &ManualView::Handbuch_Suche_Return);
    connect(Handbuch_Suche, &QLineEdit::textEdited, this, [this] { Handbuch_Stand->clear(); });
    Handbuch_Weiter = button("Handbuch_Weiter", {1115, "Weiter&suchen"}, this, &ManualView::Handbuch_Suche_Return);
    m_book.tip(Handbuch_Weiter, {1114, "Im Kapitel suchen"});
    Handbuch_Stand = named<QLabel>("Handbuch_Stand", this);
    Handbuch_Schliessen = button("Handbuch_Schliessen", {688, "&Schließen"}, this, &QDialog::close);
    m_book.tip(Handbuch_Schliessen, {1121, "Schließt nur diese Ansicht; was läuft, läuft weiter"});
    const auto* find = new QShortcut(QKeySequence::Find, this);
    connect(find, &QShortcut::activated, Handbuch_Suche, [this] {
        Handbuch_Suche->setFocus();
        Handbuch_Suche->selectAll();
    });
    arrange();
    label();
}

void ManualView::arrange() {
    layOut(this,
           column({row({Handbuch_Zurueck, Handbuch_Vor, Handbuch_Inhalt, kRoom, {Handbuch_Suche, 1}, Handbuch_Weiter}),
                   {Handbuch_Text, 1},
                   row({Handbuch_Stand, kRoom, Handbuch_Schliessen})}),
           6);
    // In letters, so that it is the same on every display.
    resize(fontMetrics().averageCharWidth() * 140, fontMetrics().height() * 46);
    Handbuch_Text->setFocus();
}

QString ManualView::languageFolder() const {
    const std::filesystem::path language = m_with.state.language == "deutsch" ? "de" : "en";
    return QString::fromStdString(utf8Of(m_folder / language));
}

void ManualView::label() {
    m_book.label(m_with.captions);
    setWindowTitle(captionText(m_with.captions, {1110, "&Handbuch"}).remove(QLatin1Char('&')));
    Handbuch_Suche->setPlaceholderText(captionText(m_with.captions, {1114, "Im Kapitel suchen"}));
    const QString shown = Handbuch_Text->source().fileName();
    if (m_language != languageFolder() && !shown.isEmpty()) showChapter(shown);
}

void ManualView::openAt(const ManualPlace& place) {
    showChapter(QString::fromLatin1(place.chapter));
    show();
    raise();
    activateWindow();
    showSectionOf(QString::fromLatin1(place.picture));  // now that its width is known
}

void ManualView::showChapter(const QString& chapter) {
    m_language = languageFolder();
    const QString file = m_language + QLatin1Char('/') + chapter;
    if (QFileInfo(file).isReadable()) {
        Handbuch_Text->setSource(QUrl::fromLocalFile(file));
        return;
    }
    Handbuch_Text->setSource(QUrl());  // so that the chapter is read anew when it is there
    Handbuch_Text->setPlainText(captionText(m_with.captions, {1116, "Das Handbuch fehlt. Gesucht wurde %1"})
                                    .arg(QDir::toNativeSeparators(file)));
}

/// From its heading on; a chapter that has no such picture is left as it is.
void ManualView::showSectionOf(const QString& picture) {
    Handbuch_Text->verticalScrollBar()->setValue(0);
    if (picture.isEmpty()) return;
    QTextBlock block = Handbuch_Text->document()->begin();
    while (block.isValid() && !holdsPicture(block, picture)) block = block.next();
    while (block.isValid() && block.blockFormat().headingLevel() == 0) block = block.previous();
    if (!block.isValid()) return;
    const QRect heading = Handbuch_Text->cursorRect(QTextCursor(block));
    Handbuch_Text->verticalScrollBar()->setValue(heading.top() - kGap);
}

void ManualView::Handbuch_Suche_Return() {
    const QString text = Handbuch_Suche->text();
    bool found = Handbuch_Text->find(text);
    if (!found) {  // from the beginning
        const QTextCursor place = Handbuch_Text->textCursor();
        Handbuch_Text->moveCursor(QTextCursor::Start);
        found = Handbuch_Text->find(text);
        if (!found) Handbuch_Text->setTextCursor(place);
    }
    Handbuch_Stand->setText(found ? QString() : captionText(m_with.captions, {1117, "Nicht gefunden: %1"}).arg(text));
}

}  // namespace kdx
