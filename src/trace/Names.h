/// \file
/// The CIM classes that the library serves or names, and the names under which its providers are
/// registered. A provider's name is also the component of its broker traces.
#ifndef TAVRO_GLIMMARK_NAMES_H
#define TAVRO_GLIMMARK_NAMES_H

namespace Tavro::GlimmarkProvider {

/// The alarm device: one instance for each diagnostic indicator.
inline constexpr char GlimmarkClass[] = "TAVRO_Glimmark";
/// The capabilities object that all indicators share.
inline constexpr char GlimmarkCapabilitiesClass[] = "TAVRO_GlimmarkCapabilities";
/// Association of an indicator ("ManagedElement") and the capabilities object ("Capabilities").
inline constexpr char GlimmarkElementCapabilitiesClass[] = "TAVRO_GlimmarkElementCapabilities";
/// Association of a computer system ("GroupComponent") and an indicator ("PartComponent").
inline constexpr char GlimmarkSystemDeviceClass[] = "TAVRO_GlimmarkSystemDevice";
/// The hosting computer system; another provider of the same broker serves it.
inline constexpr char ComputerSystemClass[] = "TAVRO_ComputerSystem";

inline constexpr char GlimmarkProfileProvider[] = "GlimmarkProfileProvider";
inline constexpr char GlimmarkCapabilitiesProvider[] = "GlimmarkCapabilitiesProvider";
inline constexpr char GlimmarkElementCapabilitiesProvider[] = "GlimmarkElementCapabilitiesProvider";
inline constexpr char GlimmarkSystemDeviceProvider[] = "GlimmarkSystemDeviceProvider";

} // namespace Tavro::GlimmarkProvider

#endif
