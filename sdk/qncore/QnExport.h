#pragma once

/// Marks what the host core shares with plug-ins. Everything else in the host is hidden.
#define QNCORE_API __attribute__((visibility("default")))

/// Marks an entry function of a plug-in file: found by its plain name, never by a mangled one.
#define QN_PLUGIN_ENTRY extern "C" __attribute__((visibility("default")))

/// The version of this programming interface. A plug-in answers it from `QuarnPlugInSdkVersion` and
/// `QuarnPlugInSdkServiceRelease`; the host refuses a plug-in that answers another number.
inline constexpr unsigned int QUARN_SDK_VERSION = 2353819966U;
