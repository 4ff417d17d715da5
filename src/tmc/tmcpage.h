#pragma once

#include "ui/page.h"

namespace kdx {

class TmcBuilder;
class TmcTransmission;

/// The page "T M C": composes traffic messages, lists them and sends them.
class TmcPage : public Page {
    Q_OBJECT
public:
    TmcPage(const PageContext& with, QWidget* parent);

    void label() override;
    /// @throws std::runtime_error as reloadLists does, after everything else is set up.
    void load() override;
    /// Fills the event and location boxes from the files of the data folder.
    /// @throws std::runtime_error when one is missing; the page goes on with an empty box.
    void reloadLists();

private:
    TmcBuilder* m_builder = nullptr;
    TmcTransmission* m_transmission = nullptr;
};

}  // namespace kdx
