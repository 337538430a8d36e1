// An object that every thread has for itself.

#ifndef KESTREL_PLATFORM_THREADOBJECT_H
#define KESTREL_PLATFORM_THREADOBJECT_H

#include <cstdint>
#include <memory>
#include <new>

namespace MCKestrel_800 {

/// A place where every thread keeps a pointer of its own, null at first. Only on Windows; ThreadObject uses
/// it.
class ThreadSlot {
 public:
  /// `destroy` gets the pointer of a thread that ends, unless it is null.
  explicit ThreadSlot(void (*destroy)(void*));
  ~ThreadSlot();
  ThreadSlot(const ThreadSlot&) = delete;
  ThreadSlot& operator=(const ThreadSlot&) = delete;

  void* Get() const;
  /// False when the system has no room for it.
  bool Set(void* pointer);

 private:
  std::uint32_t index_;
};

/// The calling thread's object of a type; it is made at the first call and destroyed when the thread ends.
/// Errors: std::bad_alloc.
///
/// The place of a thread_local variable whose type has a destructor: in a library that MinGW built, such a
/// variable's memory may be freed before its destructor runs.
template <typename Object>
Object& ThreadObject() {
#if defined(_WIN32)
  static ThreadSlot slot([](void* object) { delete static_cast<Object*>(object); });
  if (void* object = slot.Get()) return *static_cast<Object*>(object);
  auto made = std::make_unique<Object>();
  if (!slot.Set(made.get())) throw std::bad_alloc();
  return *made.release();
#else
  thread_local Object object;
  return object;
#endif
}

}  // namespace MCKestrel_800

#endif  // KESTREL_PLATFORM_THREADOBJECT_H
