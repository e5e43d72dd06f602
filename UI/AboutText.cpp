#include "UI/AboutText.h"

#include "Platform/ProgramInformation.h"

namespace spectrel {

AboutText AboutText::text()
{
    return {"Spectrel", programVersion().value_or(""), "Live radio diagnostics: which cell, how well, what else"};
}

} // namespace spectrel
