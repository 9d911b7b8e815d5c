// The scale services module "PyrSrvEchelle15.arx": registers "PyralisEchelleServices r17.2", the drawing
// scale used by the coded survey processing.
#include "ServiceModule.h"
#include "host/HostTexts.h"
#include "host/Services.h"

namespace {

using namespace pyr::host;

class ScaleServices : public CPyrEchelleServices {
public:
    int ScaleDenominator() const override { return m_denominator; }
    void SetScaleDenominator(int denominator) override {
        if (denominator > 0) m_denominator = denominator;
    }

private:
    int m_denominator = 500;
};

ScaleServices g_services;

} // namespace

extern "C" __attribute__((visibility("default"))) int acrxEntryPoint(int message, void* packet) {
    return ServiceModuleEntryPoint(message, packet, kScaleServicesName, &g_services);
}

extern "C" __attribute__((visibility("default"))) int acrxGetApiVersion() {
    return AcRx::kApiVersion;
}
