// The whole library.
#pragma once

#include "tessal/analysis.h"
#include "tessal/element.h"
#include "tessal/message.h"
#include "tessal/pages.h"
#include "tessal/template.h"
#include "tessal/version.h"
