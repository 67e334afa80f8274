// How the plug-in's calls and data reach the host's libraries. The host's functions have plain
// C names and the C calling convention (the default), so a plug-in built by any compiler can
// link against them; on Windows the argument blocks are data that the host's main library
// exports and the plug-in imports.
#pragma once

#if defined(_WIN32) && !defined(PANDEX_BUILDING_QELDLL)
#define QELDLL_DATA __declspec(dllimport)
#else
#define QELDLL_DATA
#endif
