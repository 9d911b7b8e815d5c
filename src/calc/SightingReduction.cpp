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
    double x, y, z;
    PointPlaceOf(carnet, stationIndex, x, y, z);
    return StationPlaceAt(carnet, stationIndex, x, y, z);
}

StationPlace StationPlaceAt(const CCarnet& carnet, int stationIndex, double x, double y, double z) {
    StationPlace station;
    station.index = stationIndex;
    station.name = carnet.matAt(stationIndex);
    station.reprise = carnet.RepriseAt(stationIndex);
    station.x = x, station.y = y, station.z = z;
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
    // The store keeps each element under the kind of its class: a sighting's kind tells it is one.
    if (!IsSightingKind(carnet.GetType(sighting))) return reduced;
    const auto* visee = static_cast<const CVisee*>(carnet.GetAt(sighting));
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
        SinCosGrads(av, reduced.sinAv, reduced.cosAv);
        double dh = di * reduced.sinAv;
        if (dh > 0.0) {
            CorrectHorizontalDistance(dh, station.x, station.y, station.z, options.correction);
            reduced.dh = dh;
        }
    }
    return reduced;
}

double TrigonometricHeightDifference(double dh, double sinZ, double cosZ, double hi, double hp) {
    return dh * cosZ / sinZ + hi - hp + CurvatureRefraction(dh);
}

double TrigonometricHeightDifference(double dh, double zenith, double hi, double hp) {
    double sinZ = 0.0, cosZ = 0.0;
    SinCosGrads(zenith, sinZ, cosZ);
    return TrigonometricHeightDifference(dh, sinZ, cosZ, hi, hp);
}

} // namespace pyr
