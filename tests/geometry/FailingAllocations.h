#pragma once

/// How many allocations of this test program succeed before all fail; below 0 none fails.
extern int g_iAllocationsLeft;
