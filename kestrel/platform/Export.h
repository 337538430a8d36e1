// Marks what the shared libraries show to others. Everything else is hidden.

#ifndef KESTREL_PLATFORM_EXPORT_H
#define KESTREL_PLATFORM_EXPORT_H

#if defined(_WIN32)
#if defined(KESTREL_CORE_BUILD)
#define KESTREL_API __declspec(dllexport)
#else
#define KESTREL_API __declspec(dllimport)
#endif
#define KESTREL_PLUGIN_API __declspec(dllexport)
#else
/// A class or function of the core library.
#define KESTREL_API __attribute__((visibility("default")))
/// An entry point of a plug-in.
#define KESTREL_PLUGIN_API __attribute__((visibility("default")))
#endif

/// The version that a plug-in built with these headers is for, "major.minor"; the build checks it against the
/// project's. Objects of other versions are laid out otherwise, so the core loads no plug-in that tells
/// another one.
#define KESTREL_PLUGIN_VERSION "8.0"

#endif  // KESTREL_PLATFORM_EXPORT_H
