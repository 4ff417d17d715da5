#include "af/aflistview.h"

#include "af/modul2.h"
#include "settings/storedvalue.h"
#include "ui/layouts.h"

namespace kdx {

void AfListView::createOptions(const char* name, int caption, CaptionBook& book, QWidget* parent) {
    m_options.create(name, parent);
    for (std::size_t i = 0; i < m_options.size(); ++i) {
        book.text(m_options[i], {caption, "", QStringLiteral(" %1").arg(i + 1)});
    }
}

void AfListView::createContent(QLabel* tuned, const Caption& tunedHeading, const char* list, const Caption& listHeading,
                               CaptionBook& book) {
    QWidget* parent = tuned->parentWidget();
    m_tuned = tuned;
    m_tuned->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    m_tunedHeading = book.captioned<QLabel>("", tunedHeading, parent);
    m_listHeading = book.captioned<QLabel>("", listHeading, parent);
    m_list = named<QListWidget>(list, parent);
    book.head(m_tunedHeading, m_tuned);
    book.head(m_listHeading, m_list);
}

QBoxLayout* AfListView::optionColumn() const {
    return add(column(m_options), {kRoom});
}

QBoxLayout* AfListView::contentColumn() const {
    return column({m_tunedHeading, m_tuned, m_listHeading, {m_list, 1}});
}

void AfListView::chooseStored(std::string_view number) {
    m_options.choose(storedNumber(number, 1, kAfLists));
}

void AfListView::show(std::string_view listText) {
    FillAfLists(*m_list, *m_tuned, listText);
}

void AfListView::mark(const Judgement& judgement) {
    showJudgement(*m_list, judgement);
    showJudgement(*m_tuned, judgement);
}

}  // namespace kdx
