#include "orbane/ImageParam.h"

#include "orbane/ClassIDs.h"

namespace Orbane {

ImageParam::ImageParam(OrbString path) : Path(std::move(path))
{
    if (!Path.IsEmpty())
        Image.load(QString::fromUtf8(Path.c_str()));
}

const OrbID &ImageParam::DataType() const noexcept
{
    return CLSID_DataType_Image;
}

Parameter *ImageParam::Clone() const
{
    return new ImageParam(Path, Image);
}

bool ImageParam::Equals(const Parameter &o) const
{
    const auto *i = dynamic_cast<const ImageParam *>(&o);
    return i && i->Path == Path;
}

} // namespace Orbane
