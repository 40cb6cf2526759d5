#pragma once

/// The number of allocations in this test program that succeed before all fail; negative for no limit.
extern int g_iAllocationsLeft;
