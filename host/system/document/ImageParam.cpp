#include "orbane/ImageParam.h"

#include "orbane/ClassIDs.h"
#include "orbane/ImageFile.h"

namespace Orbane {

ImageParam::ImageParam(OrbString path) : Path(std::move(path))
{
    if (!Path.IsEmpty())
        Image = ImageFile::Read(QString::fromUtf8(Path.c_str()));
}

const OrbID &ImageParam::DataType() const noexcept
{
    return CLSID_DataType_Image;
}

Parameter *ImageParam::Clone() const
{
    return new ImageParam(Path, Image);
}

// The pixels count in full, though copies share them: the history must not
// hold more than its bound even when every step holds another image.
std::size_t ImageParam::Footprint() const noexcept
{
    return kSmallFootprint + std::size_t(Image.sizeInBytes()) + Path.str().size();
}

bool ImageParam::Equals(const Parameter &o) const
{
    const auto *i = dynamic_cast<const ImageParam *>(&o);
    return i && i->Path == Path;
}

} // namespace Orbane
