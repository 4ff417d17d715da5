#pragma once

#include "station/readout.h"

namespace kdx {

class ProfileText;

/// Puts what was read into the text of a data-set file, the multiplex and the carrier too, which data sets leave to
/// other files. What the text says besides stays; what gave no answer, or one that no instrument can have, is not
/// touched.
void keep(const Readout& readout, ProfileText& text);

}  // namespace kdx
