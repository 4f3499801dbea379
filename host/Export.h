#pragma once

/// What a library shows to others. Libraries are built with hidden visibility, so only what carries one of these marks can be
/// linked against. An interface or exception needs the mark even without code of its own: its type is compared across libraries.

/// Marks a type or function of the installed headers.
#define CIMDELTA_EXPORT [[gnu::visibility("default")]]

/// Marks a type or function that only cimdelta, the tests and the benchmarks use. Its header is not installed, and it may change at
/// any time.
#define CIMDELTA_INTERNAL_EXPORT [[gnu::visibility("default")]]
