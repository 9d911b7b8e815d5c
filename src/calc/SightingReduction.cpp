#include "calc/SightingReduction.h"

#include "core/Angles.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "settings/CalcOptions.h"

namespace pyr {

std::string StationPlace::Designation() const {
    return Sprintf("%s(%d)", name.c_str(), reprise);
}

bool PointPlaceOf(const CCarnet& carnet, int index, double& x, double& y, double& z) {
    x = y = z = kUndefined;
    for (int i : carnet.SameMat(index)) {
        if (carnet.GetType(i) != kKindPoint) continue;
        const auto* point = static_cast<const CPointGen*>(carnet.GetAt(i));
        if (!IsKnown(x) && point->hasXY()) x = point->x(), y = point->y();
        if (!IsKnown(z) && point->hasZ()) z = point->z();
        if (IsKnown(x) && IsKnown(z)) break;
    }
    return IsKnown(x);
}

bool PointPlace(const CCarnet& carnet, std::string_view mat, double& x, double& y, double& z) {
    const int first = carnet.findMat(mat);
    if (first < 0) {
        x = y = z = kUndefined;
        return false;
    }
    return PointPlaceOf(carnet, first, x, y, z);
}

StationPlace StationPlaceAt(const CCarnet& carnet, int stationIndex) {
    StationPlace station;
    station.index = stationIndex;
    station.name = carnet.matAt(stationIndex);
    station.reprise = carnet.RepriseAt(stationIndex);
    PointPlace(carnet, station.name, station.x, station.y, station.z);
    station.hi = carnet.hiAt(stationIndex);
    if (IsKnown(station.hi)) station.hi += carnet.findEV(stationIndex, -1);
    station.v0 = carnet.v0At(stationIndex);
    return station;
}

EccentricOffsets EccentricOffsetsOf(const CCarnet& carnet, int element, int limit) {
    return {carnet.findER(element, limit), carnet.findET(element, limit), carnet.findEV(element, limit)};
}

InstrumentConstants InstrumentConstantsAt(const CCarnet& carnet, int stationIndex,
                                          const InstrumentOptions& byDefault) {
    if (const CAppareil* instrument = carnet.findAppAt(stationIndex))
        return {instrument->collVerticale(), instrument->constPrisme()};
    return {byDefault.verticalCollimation, byDefault.prismConstant};
}

void ApplyInstrumentConstants(double& av, double& di, const InstrumentConstants& constants) {
    if (IsKnown(av)) av += constants.verticalCollimation;
    if (di > 0.0) di += constants.prismConstant;
}

InstrumentOptions DefaultInstrument(std::string_view paramPath) {
    const std::vector<InstrumentOptions> instruments = ReadInstruments(paramPath);
    const auto number =
        static_cast<std::size_t>(ReadOptionInt(paramPath, kSectionCalculations, kKeyDefaultInstrument));
    return instruments[number < instruments.size() ? number : 0];
}

ReducedSighting ReduceSighting(const CCarnet& carnet, const StationPlace& station, int sighting,
                               const SightingReductionOptions& options) {
    ReducedSighting reduced;
    const auto* visee = carnet.As<CVisee>(sighting);
    if (!visee) return reduced;
    reduced.index = sighting;
    reduced.mat = visee->mat();

    double ah = visee->ah(), av = visee->av(), di = visee->di();
    double hp = options.targetHeights ? visee->hp() : 0.0;
    if (options.instrumentConstants)
        ApplyInstrumentConstants(av, di,
                                 InstrumentConstantsAt(carnet, station.index, options.defaultInstrument));
    reduced.faceRight = ReduceToFaceLeft(ah, av);
    const EccentricOffsets offsets = EccentricOffsetsOf(carnet, sighting, station.index);
    ReduceEccentricSighting(ah, av, di, hp, offsets.radial, offsets.tangential,
                            options.targetHeights ? offsets.vertical : 0.0, false);
    reduced.ah = ah, reduced.av = av, reduced.di = di, reduced.hp = hp;

    if (di > 0.0 && IsKnown(av)) {
        double dh = di * SinGrads(av);
        if (dh > 0.0) {
            CorrectHorizontalDistance(dh, station.x, station.y, station.z, options.correction);
            reduced.dh = dh;
        }
    }
    return reduced;
}

double TrigonometricHeightDifference(double dh, double zenith, double hi, double hp) {
    double sinZ = 0.0, cosZ = 0.0;
    SinCosGrads(zenith, sinZ, cosZ);
    return dh * cosZ / sinZ + hi - hp + CurvatureRefraction(dh);
}

} // namespace pyr
