// The change of projection of a GéoBase: every point with a planimetry converted from one system into
// another, all of them or none.
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "projection/Projection.h"
#include "projection/ProjectionMessages.h"
#include "ui/FrontEnd.h"

#include <vector>

namespace pyr {

bool CCarnet::Projection(std::string_view from, std::string_view to, ui::FrontEnd* parent) {
    auto refuse = [parent](const std::string& text) {
        (parent ? *parent : ui::ApplicationFrontEnd()).MessageBox(text, ui::kCaption, ui::kIconWarning);
        return false;
    };
    const CProjection source(from);
    const CProjection target(to);
    for (const CProjection* projection : {&source, &target})
        if (!projection->IsValid()) return refuse(Sprintf(msg::kChangeRefused, projection->Error().c_str()));
    if (source.IsNone() || target.IsNone()) return refuse(msg::kChangeNeedsProjections);

    // Every point is converted before any is written: a point that cannot be converted leaves the
    // whole GéoBase as it was. Heights do not change.
    struct Converted {
        CPointGen* point;
        double x, y;
    };
    std::vector<Converted> converted;
    for (int index = 0; index < GetSize(); ++index) {
        CPointGen* point = GetType(index) == kKindPoint ? As<CPointGen>(index) : nullptr;
        if (!point || !point->hasXY()) continue;
        double x = point->x(), y = point->y();
        if (!source.Convert(target, x, y))
            return refuse(Sprintf(msg::kChangePointFailed, point->mat().c_str(), source.Name().c_str(),
                                  target.Name().c_str()));
        converted.push_back({point, x, y});
    }
    for (const Converted& c : converted)
        c.point->setPt(c.x, c.y); // rounded to the decimals of coordinates, invariance kept
    return true;
}

} // namespace pyr
