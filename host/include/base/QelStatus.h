#pragma once
// Status codes shared by the host and the module. Operations never throw across the
// host/module boundary; they answer one of these 32-bit values instead.
#include <cstdint>

using HRESULT = int32_t;

inline constexpr HRESULT S_OK = 0;
inline constexpr HRESULT S_FALSE = 1;
inline constexpr HRESULT E_NOTIMPL = static_cast<HRESULT>(0x80004001u);
inline constexpr HRESULT E_NOINTERFACE = static_cast<HRESULT>(0x80004002u);
inline constexpr HRESULT E_FAIL = static_cast<HRESULT>(0x80004005u);
inline constexpr HRESULT E_UNEXPECTED = static_cast<HRESULT>(0x8000FFFFu);

inline constexpr bool QelSucceeded(HRESULT hr) { return hr >= 0; }
inline constexpr bool QelFailed(HRESULT hr) { return hr < 0; }

// Check state of a facet property. The display answer of the facet services (S_OK shown,
// S_FALSE hidden) is stored as a check state unchanged, hence the shared values.
using QelCheckState = int32_t;
inline constexpr QelCheckState Checked = 0;
inline constexpr QelCheckState Unchecked = 1;
inline constexpr QelCheckState PartiallyChecked = 0x40202;
