#include "inputcontrols/LazyComboBox.h"

namespace Orbane {

void LazyComboBox::showPopup()
{
    emit FillRequested();
    QComboBox::showPopup();
}

} // namespace Orbane
