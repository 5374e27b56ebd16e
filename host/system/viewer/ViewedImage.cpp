#include "orbane/ViewedImage.h"

namespace Orbane {

ViewedImage &ViewedImage::Instance()
{
    static ViewedImage instance;
    return instance;
}

void ViewedImage::Set(const FloatImage &image)
{
    mImage = image;
    ++mSerial;
    emit Changed();
}

} // namespace Orbane
