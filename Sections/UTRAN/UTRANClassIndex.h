#pragma once

#include "LogGenerator/Template/ClassIndex.h"

namespace spectrel {

/// The sections of a UTRAN baseband; none are known yet.
class UTRANClassIndex final : public ClassIndex { };

} // namespace spectrel
