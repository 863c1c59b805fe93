// What the library shows of itself. Everything else in it is hidden.
#pragma once

#if defined(_WIN32)
#define TESSAL_API
#else
#define TESSAL_API __attribute__((visibility("default")))
#endif
