#include "UI/Quick/Measures.h"

#include "UI/Quick/QuickText.h"
#include "UI/SpectrelCell.h"
#include "UI/SpectrelPaneController.h"
#include "UI/SpectrelSaveViewController.h"

namespace spectrel {

double Measures::rowHeight()
{
    return SpectrelCell::ScrollViewHeight;
}

double Measures::entryHeight()
{
    return SpectrelSaveViewController::RowHeight;
}

QFont Measures::nameFont()
{
    return shownFont(SpectrelCell::KeyFont);
}

QFont Measures::valueFont()
{
    return shownFont(SpectrelCell::ValueFont);
}

QFont Measures::statusFont()
{
    return shownFont(SpectrelPaneController::StatusFont);
}

QFont Measures::entryFont()
{
    return shownFont(SpectrelSaveViewController::CellFont);
}

} // namespace spectrel
