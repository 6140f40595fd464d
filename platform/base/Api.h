#pragma once

/// Marks what the platform library exports. The library is built with hidden visibility.
#define KTR_API __attribute__((visibility("default")))
