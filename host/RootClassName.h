#pragma once

namespace NORVZEL20 {

/// The name of the pseudo-class above all top-level classes. ICIMNamespace::GetClass finds it; no class of this name can be
/// declared.
inline constexpr char kRootClassName[] = "<root>";

}  // namespace NORVZEL20
