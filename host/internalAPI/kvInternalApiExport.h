#pragma once

/// Marks what libKVinternalAPI exports.
#define KVINTERNALAPI_API __attribute__((visibility("default")))
