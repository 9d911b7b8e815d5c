#include "projection/Projection.h"

#include "core/Strings.h"
#include "core/Undefined.h"
#include "projection/LevelSurface.h"
#include "projection/ProjectionMessages.h"
#include "projection/ProjectionNames.h"

#include <cmath>
#include <limits>
#include <proj.h>
#include <proj_experimental.h>

namespace pyr {

namespace {

struct ContextDeleter {
    void operator()(PJ_CONTEXT* context) const { proj_context_destroy(context); }
};
struct ObjectDeleter {
    void operator()(PJ* object) const { proj_destroy(object); }
};
using Context = std::unique_ptr<PJ_CONTEXT, ContextDeleter>;
using Object = std::unique_ptr<PJ, ObjectDeleter>;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

bool Usable(double x, double y) {
    return IsKnown(x) && IsKnown(y) && std::isfinite(x) && std::isfinite(y);
}

// The projection of a projected system alone, from longitude and latitude in radians (longitude from
// Greenwich, whatever the system's prime meridian) on its ellipsoid to easting and northing in metres:
// what proj_factors needs, and its inverse gives the latitude of a place. Null when PROJ cannot build it.
Object BareProjection(PJ_CONTEXT* context, PJ* crs, PJ* geodetic, double semiMajorAxis,
                      double inverseFlattening) {
    const Object conversion(proj_crs_get_coordoperation(context, crs));
    const Object angularAxes(
        proj_create_ellipsoidal_2D_cs(context, PJ_ELLPS2D_LONGITUDE_LATITUDE, "Radian", 1.0));
    const Object planeAxes(proj_create_cartesian_2D_cs(context, PJ_CART2D_EASTING_NORTHING, "metre", 1.0));
    if (!conversion || !angularAxes || !planeAxes) return nullptr;
    const Object geographic(proj_create_geographic_crs(context, "geographique", "datum", "ellipsoide",
                                                       semiMajorAxis, inverseFlattening, "Greenwich", 0.0,
                                                       nullptr, 0.0, angularAxes.get()));
    const Object plane(
        proj_create_projected_crs(context, "plan", geodetic, conversion.get(), planeAxes.get()));
    if (!geographic || !plane) return nullptr;
    return Object(proj_create_crs_to_crs_from_pj(context, geographic.get(), plane.get(), nullptr, nullptr));
}

} // namespace

struct CProjection::Impl {
    // What is known of a place: its latitude (radians) and the point scale factor there, NaN when
    // PROJ cannot tell.
    struct Place {
        double x = kNaN, y = kNaN;
        double latitude = kNaN;
        double scale = kNaN;
    };

    Context context; // first: every object below belongs to it and goes before it
    Object crs;
    Object bareProjection;
    int epsg = 0;
    double semiMajorAxis = 0.0; // metres
    double flattening = 0.0;
    double metresPerUnit = 1.0; // the unit of the system's coordinates
    Place last;
    std::string conversionTarget; // "EPSG:nnnn" of the system `conversion` goes to
    Object conversion;

    static std::unique_ptr<Impl> Open(int epsg, const std::string& name, std::string& error);
    const Place& At(double x, double y);
    PJ* ConversionTo(int targetEpsg);
};

std::unique_ptr<CProjection::Impl> CProjection::Impl::Open(int epsg, const std::string& name,
                                                           std::string& error) {
    auto impl = std::make_unique<Impl>();
    impl->epsg = epsg;
    impl->context.reset(proj_context_create());
    PJ_CONTEXT* context = impl->context.get();
    proj_log_level(context, PJ_LOG_NONE); // PROJ's reasons are told in French, not on stderr
    proj_context_set_enable_network(context, 0);
    if (!proj_context_get_database_path(context)) {
        error = Sprintf(msg::kProjectionNoDatabase, name.c_str());
        return nullptr;
    }
    impl->crs.reset(proj_create(context, Sprintf("EPSG:%d", epsg).c_str()));
    if (!impl->crs) {
        error = Sprintf(msg::kProjectionEpsgUnknown, name.c_str(), epsg);
        return nullptr;
    }
    if (proj_get_type(impl->crs.get()) != PJ_TYPE_PROJECTED_CRS) {
        error = Sprintf(msg::kProjectionNotProjected, name.c_str(), epsg);
        return nullptr;
    }
    const Object geodetic(proj_crs_get_geodetic_crs(context, impl->crs.get()));
    const Object ellipsoid(geodetic ? proj_get_ellipsoid(context, geodetic.get()) : nullptr);
    const Object axes(proj_crs_get_coordinate_system(context, impl->crs.get()));
    double semiMinorAxis = 0.0, inverseFlattening = 0.0;
    int computed = 0;
    if (ellipsoid && axes &&
        proj_ellipsoid_get_parameters(context, ellipsoid.get(), &impl->semiMajorAxis, &semiMinorAxis,
                                      &computed, &inverseFlattening) &&
        proj_cs_get_axis_info(context, axes.get(), 0, nullptr, nullptr, nullptr, &impl->metresPerUnit,
                              nullptr, nullptr, nullptr))
        impl->bareProjection =
            BareProjection(context, impl->crs.get(), geodetic.get(), impl->semiMajorAxis, inverseFlattening);
    if (!impl->bareProjection) {
        error = Sprintf(msg::kProjectionUnusable, name.c_str(), epsg);
        return nullptr;
    }
    impl->flattening = inverseFlattening > 0.0 ? 1.0 / inverseFlattening : 0.0; // 0: a sphere
    return impl;
}

const CProjection::Impl::Place& CProjection::Impl::At(double x, double y) {
    if (x == last.x && y == last.y) return last;
    last = Place{x, y};
    PJ* projection = bareProjection.get();
    proj_errno_reset(projection);
    const PJ_COORD geographic =
        proj_trans(projection, PJ_INV, proj_coord(x * metresPerUnit, y * metresPerUnit, 0.0, 0.0));
    if (!std::isfinite(geographic.lp.lam) || !std::isfinite(geographic.lp.phi) ||
        std::fabs(geographic.lp.phi) > M_PI_2)
        return last;
    last.latitude = geographic.lp.phi;
    const PJ_FACTORS factors = proj_factors(projection, geographic);
    // A conformal projection (every named one) has the same scale in all directions; for another
    // one, the scale along the parallel is taken.
    if (proj_errno(projection) == 0 && std::isfinite(factors.parallel_scale) && factors.parallel_scale > 0.0)
        last.scale = factors.parallel_scale;
    return last;
}

PJ* CProjection::Impl::ConversionTo(int targetEpsg) {
    const std::string target = Sprintf("EPSG:%d", targetEpsg);
    if (target == conversionTarget) return conversion.get();
    conversionTarget = target;
    conversion.reset();
    PJ_CONTEXT* ctx = context.get();
    const Object operation(
        proj_create_crs_to_crs(ctx, Sprintf("EPSG:%d", epsg).c_str(), target.c_str(), nullptr));
    // Easting first, northing second, whatever order the systems declare.
    if (operation) conversion.reset(proj_normalize_for_visualization(ctx, operation.get()));
    return conversion.get();
}

CProjection::CProjection(std::string_view name, double earthRadiusKm)
    : m_name(Trimmed(name)), m_earthRadiusKm(earthRadiusKm) {
    const ProjectionName resolved = ResolveProjectionName(m_name);
    m_none = resolved.none;
    m_error = resolved.error;
    if (m_none || !m_error.empty()) return;
    m_impl = Impl::Open(resolved.epsg, m_name, m_error);
}

CProjection::~CProjection() = default;
CProjection::CProjection(CProjection&&) noexcept = default;
CProjection& CProjection::operator=(CProjection&&) noexcept = default;

bool CProjection::IsNone() const {
    return m_none;
}

int CProjection::Epsg() const {
    return m_impl ? m_impl->epsg : 0;
}

double CProjection::CalcLinearAlter(double x, double y) const {
    if (!m_impl || !Usable(x, y)) return 0.0;
    const double scale = m_impl->At(x, y).scale;
    return std::isnan(scale) ? 0.0 : (scale - 1.0) * 1e6;
}

double CProjection::CalcEllipsReduc(double x, double y, double z, int direction) const {
    if (!IsKnown(z) || !std::isfinite(z)) return 0.0;
    double radius = m_earthRadiusKm * 1000.0;
    if (m_impl && Usable(x, y)) {
        const double latitude = m_impl->At(x, y).latitude;
        if (!std::isnan(latitude))
            radius = GaussianMeanRadius(m_impl->semiMajorAxis, m_impl->flattening, latitude);
    }
    return LevelSurfaceReductionPpm(z, radius, direction);
}

bool CProjection::Convert(const CProjection& to, double& x, double& y) const {
    if (!m_impl || !to.m_impl || !Usable(x, y)) return false;
    PJ* operation = m_impl->ConversionTo(to.m_impl->epsg);
    if (!operation) return false;
    // Only the result tells: PROJ may note an error on a first candidate operation and succeed on
    // the next one.
    const PJ_COORD converted = proj_trans(operation, PJ_FWD, proj_coord(x, y, 0.0, 0.0));
    if (!std::isfinite(converted.xy.x) || !std::isfinite(converted.xy.y)) return false;
    x = converted.xy.x;
    y = converted.xy.y;
    return true;
}

} // namespace pyr
