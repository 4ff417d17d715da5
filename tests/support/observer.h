#pragma once

#include <string>
#include <vector>

#include "link/lanvisa.h"

namespace kdx::test {

/// Another client of an instrument in the network.
class Observer {
public:
    explicit Observer(const LanOptions& options);
    void tell(const std::string& command);
    /// The whole answer without its line end.
    std::string ask(const std::string& query);
    /// A value of the coder, without the quotes around it.
    std::string askCoder(const std::string& name);
    /// Takes everything out of the error queue.
    std::vector<std::string> errors();

private:
    LanVisa m_visa;
    VisaHandle m_session = 0;
};

}  // namespace kdx::test
