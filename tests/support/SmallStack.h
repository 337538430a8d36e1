// Runs code on a thread with a stack of a given size, as hosts have them.

#ifndef KESTREL_TESTS_SUPPORT_SMALLSTACK_H
#define KESTREL_TESTS_SUPPORT_SMALLSTACK_H

#include <gtest/gtest.h>

#include <cstddef>
#if defined(_WIN32)
#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
#else
#include <pthread.h>
#endif

namespace kestrel_test {

/// Runs `action` to its end on a new thread. Exceptions must not leave it.
template <typename Action>
void RunOnStack(size_t bytes, Action action) {
#if defined(_WIN32)
  const auto run = [](void* argument) -> DWORD {
    (*static_cast<Action*>(argument))();
    return 0;
  };
  const HANDLE thread =
      CreateThread(nullptr, bytes, run, &action, STACK_SIZE_PARAM_IS_A_RESERVATION, nullptr);
  ASSERT_NE(thread, nullptr);
  EXPECT_EQ(WaitForSingleObject(thread, INFINITE), WAIT_OBJECT_0);
  CloseHandle(thread);
#else
  pthread_attr_t attributes;
  ASSERT_EQ(pthread_attr_init(&attributes), 0);
  ASSERT_EQ(pthread_attr_setstacksize(&attributes, bytes), 0);
  const auto run = [](void* argument) -> void* {
    (*static_cast<Action*>(argument))();
    return nullptr;
  };
  pthread_t thread;
  ASSERT_EQ(pthread_create(&thread, &attributes, run, &action), 0);
  EXPECT_EQ(pthread_join(thread, nullptr), 0);
  pthread_attr_destroy(&attributes);
#endif
}

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_SUPPORT_SMALLSTACK_H
