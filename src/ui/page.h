#pragma once

#include <QWidget>

#include "coder/step.h"
#include "ui/form.h"

class QComboBox;

namespace kdx {

struct Place;
struct Setting;

/// A page of the window, or a frame of one that lives like a page. What its controls are called is said where they are
/// made; the window calls the rest.
class Page : public QWidget, public Form {
    Q_OBJECT
public:
    Page(const PageContext& with, QWidget* parent) : QWidget(parent), Form(with) {}

    /// Captions everything in the current language; values stay. Overridden for texts that are composed.
    virtual void label() { m_book.label(m_with.captions); }
    /// Start-up: shows what the data set and the general settings hold. Nothing is stored; nothing is sent but by
    /// handlers that are said to run.
    virtual void load() {}
    /// Another data set was loaded: shows what it holds. Nothing is stored.
    virtual void showDataSet() {}
    /// The page was opened by its tab.
    virtual void opened() {}
    /// A step of a running sequence goes out: shows what belongs to this page, and stores what sending it stores.
    virtual void stepGoesOut(const Step& /*step*/) {}
    /// That step has not reached the instrument.
    virtual void stepFailed(const Step& /*step*/) {}

protected:
    /// However wide the window is, the controls stay together.
    void resizeEvent(QResizeEvent* event) override;
    /// Sends steps at once; several are a run that the user can stop.
    void send(const Steps& steps);
    void sendAndStore(const Setting& setting, const std::string& value);
    /// Stores a text whose blanks at the edges mean something; they come back where that is corrected.
    void storeText(const Setting& setting, const std::string& text);
    /// Lists the programme types in the current language and chooses the stored one; no handler runs.
    void showProgrammeTypes(QComboBox* box, const Place& stored);
};

}  // namespace kdx
