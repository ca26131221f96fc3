#pragma once

/// The whole public interface: paint a run of glyph masks with VFEffect (VFEffect.h).
#include "VFBitmap.h"
#include "VFBlender.h"
#include "VFECore.h"
#include "VFEffect.h"
#include "VFLog.h"
#include "VFProperty.h"
#include "VFVersion.h"
