#pragma once

/// Marks what libKelmar exports. The library is built with hidden visibility, so a class or a
/// function without this mark stays inside it.
#define KELMAR_API __attribute__((visibility("default")))
