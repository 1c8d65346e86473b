#pragma once
// How the process keeps freed memory. Oscillators over a long history make and drop arrays
// of a few hundred kilobytes each; by default the C library hands each back to the system
// and pays a page fault a page to get it again, which costs more than the arithmetic.
namespace kori::platform {

// Keeps freed memory in the process for reuse (a no-op where the C library has no such
// setting). Called once at start-up by the programs.
void KeepFreedMemoryForReuse();

} // namespace kori::platform
