#pragma once

#include "orbane/OrbString.h"
#include "orbane/Parameter.h"

#include <QImage>

namespace Orbane {

// An image value (CLSID_DataType_Image): the file it was read from and its
// pixels, read once. Steps between keys. A file that cannot be read gives a
// null image; overlays then show nothing of it.
class ImageParam : public Parameter
{
public:
    explicit ImageParam(OrbString path = OrbString());
    ImageParam(OrbString path, QImage image) : Path(std::move(path)), Image(std::move(image)) {}

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;
    std::size_t Footprint() const noexcept override;
    // The same file is the same value.
    bool Equals(const Parameter &o) const override;

    OrbString Path;
    QImage Image; // implicitly shared: copies are cheap
};

} // namespace Orbane
