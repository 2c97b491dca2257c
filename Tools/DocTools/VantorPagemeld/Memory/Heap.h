#pragma once

/// Fits the heap to a run that fills it with a few large documents and texts and then ends. To be called
/// once, before those.
///
/// All memory comes from one region that only grows, and the first gigabyte of it lies in huge pages where
/// the system grants them: that saves nearly all page faults, and the kernel writes out of huge pages faster.
/// The gigabyte is address space, which counts as memory only where the system never overcommits; memory is
/// taken as it is used. Where there is a limit on address space, or the gigabyte can't be had, the heap grows
/// in small pages.
void PrepareHeap();
