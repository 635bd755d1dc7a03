/// \file
/// The names of the classes, and of the providers as they give them to the broker's trace.
#ifndef TESTS_FAILURES_DESCRIBED_NAMES_H
#define TESTS_FAILURES_DESCRIBED_NAMES_H

namespace described {

constexpr auto glimmarkClass = "TAVRO_Glimmark";
constexpr auto capabilitiesClass = "TAVRO_GlimmarkCapabilities";
constexpr auto elementClass = "TAVRO_GlimmarkElementCapabilities";
constexpr auto systemDeviceClass = "TAVRO_GlimmarkSystemDevice";
constexpr auto computerSystemClass = "TAVRO_ComputerSystem";

constexpr auto glimmarkProvider = "GlimmarkProfileProvider";
constexpr auto capabilitiesProvider = "GlimmarkCapabilitiesProvider";
constexpr auto elementProvider = "GlimmarkElementCapabilitiesProvider";
constexpr auto systemDeviceProvider = "GlimmarkSystemDeviceProvider";

} // namespace described

#endif
