#pragma once

/// Marks what a host and a loaded bundle share.
#define ZEFRA_EXPORT __attribute__((visibility("default")))
