#include "support/sourcefolder.h"

namespace kdx::test {

std::filesystem::path sourceFolder() {
    return KDX_SOURCE_DIR;
}

}  // namespace kdx::test
