// Numbers that tell one state of a container from every other in the process.

#ifndef KESTREL_DICTIONARY_LAYOUTSTAMP_H
#define KESTREL_DICTIONARY_LAYOUTSTAMP_H

namespace MCKestrel_800 {

/// A number that was never given before, other than 0. Drawn from a counter: a hash of names would be cheaper
/// to share between containers filled alike, but two layouts could have the same one, and what was looked up
/// for one would silently be used with the other. 64 bits last for centuries of one each nanosecond.
unsigned long long NewLayoutStamp();

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_LAYOUTSTAMP_H
