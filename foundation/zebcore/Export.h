#pragma once

/// Marks what the shared library exports; everything else stays hidden.
#define ZEB_EXPORT __attribute__((visibility("default")))
