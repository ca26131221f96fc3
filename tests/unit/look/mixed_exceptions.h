#pragma once

/// What the modern face calls for want of memory, in a source that is compiled without exceptions.
using Ending = void (*)();
Ending endingWithoutExceptions();
