#pragma once

// GéoBases written element by element in field order, for the tests of the computations.
#include "core/Numbers.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <memory>
#include <string>
#include <string_view>

namespace pyr {

// A GéoBase written line by line, in field order.
struct Geo : CCarnet {
    Geo& Inst(const std::string& name, double collimation, double prism) {
        return Put(std::make_unique<CAppareil>(name, collimation, prism), kKindAppareil);
    }
    Geo& Put(std::unique_ptr<CElement> element, int kind) {
        Add(std::move(element), kind);
        return *this;
    }
    Geo& Sta(const std::string& name, double hi, double v0 = kUndefined) {
        return Put(std::make_unique<CStation>(name, hi, v0), kKindStation);
    }
    Geo& Ref(const std::string& point, double hp, double ah, double av, double di, const char* code = "") {
        return Put(std::make_unique<CReference>(point, hp, ah, av, di, code), kKindReference);
    }
    Geo& Mes(const std::string& point, double hp, double ah, double av, double di, const char* code = "") {
        return Put(std::make_unique<CMesure>(point, hp, ah, av, di, code), kKindMesure);
    }
    Geo& Pt(const std::string& point, double x, double y, double z) {
        return Put(std::make_unique<CPointGen>(point, x, y, z), kKindPoint);
    }
    Geo& Exc(std::string_view word, double metres) {
        return Put(std::make_unique<CCommande>(std::string(word), FormatShortest(metres)), kKindExcentrement);
    }
};

} // namespace pyr
