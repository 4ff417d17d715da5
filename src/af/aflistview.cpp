#include "af/aflistview.h"

#include "af/modul2.h"
#include "settings/storedvalue.h"

#include <QBoxLayout>
#include <QListWidget>

namespace kdx {

void AfListView::createOptions(const char* name, int caption, CaptionBook& book, QWidget* parent) {
    m_options.create(name, parent);
    for (std::size_t i = 0; i < m_options.size(); ++i) {
        book.text(m_options[i], {caption, "", QStringLiteral(" %1").arg(i + 1)});
    }
}

void AfListView::createContent(QLabel* tuned, const Caption& heading, const Part& list, CaptionBook& book,
                               QWidget* parent) {
    m_tuned = tuned;
    m_tunedHeading = new QLabel(parent);
    m_listHeading = new QLabel(parent);
    m_list = named<QListWidget>(list.name, parent);
    m_tuned->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    for (QLabel* label : {m_tuned, m_tunedHeading, m_listHeading}) label->setTextFormat(Qt::PlainText);
    m_tunedHeading->setBuddy(m_tuned);
    m_listHeading->setBuddy(m_list);
    book.text(m_tunedHeading, heading);
    book.text(m_listHeading, list.heading);
    book.spokenAs(m_tuned, m_tunedHeading);
    book.spokenAs(m_list, m_listHeading);
}

void AfListView::arrangeOptions(QBoxLayout* column) const {
    for (QRadioButton* option : m_options) column->addWidget(option);
    column->addStretch();
}

void AfListView::arrangeContent(QBoxLayout* column) const {
    column->addWidget(m_tunedHeading);
    column->addWidget(m_tuned);
    column->addWidget(m_listHeading);
    column->addWidget(m_list, 1);
}

void AfListView::chooseStored(std::string_view number) {
    m_options.choose(storedNumber(number, 1, kAfLists));
}

void AfListView::show(std::string_view listText) {
    FillAfLists(*m_list, *m_tuned, listText);
}

}  // namespace kdx
