#pragma once
// The plug-in exports one class; everything else stays hidden.
#if defined(_WIN32)
#if defined(VELOMUX_WIZARD_BUILD)
#define QVZ_WIZARD_EXPORT __declspec(dllexport)
#else
#define QVZ_WIZARD_EXPORT __declspec(dllimport)
#endif
#else
#define QVZ_WIZARD_EXPORT __attribute__((visibility("default")))
#endif
