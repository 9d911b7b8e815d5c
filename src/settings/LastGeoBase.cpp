#include "settings/LastGeoBase.h"

#include "settings/ParamStore.h"

namespace pyr {

std::string ReadLastGeoBase(std::string_view paramPath) {
    std::string geoBase;
    ReadParamString(paramPath, kSectionGeoBase, kKeyLastGeoBase, "", geoBase);
    return geoBase;
}

bool WriteLastGeoBase(std::string_view paramPath, std::string_view geoBase) {
    return WriteParamString(paramPath, kSectionGeoBase, kKeyLastGeoBase, geoBase);
}

} // namespace pyr
