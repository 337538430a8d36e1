// Runs code on a thread with a stack of a given size, as hosts have them. For systems with POSIX threads.

#ifndef KESTREL_TESTS_SUPPORT_SMALLSTACK_H
#define KESTREL_TESTS_SUPPORT_SMALLSTACK_H

#include <gtest/gtest.h>
#include <pthread.h>

#include <cstddef>

namespace kestrel_test {

/// Runs `action` to its end on a new thread. Exceptions must not leave it.
template <typename Action>
void RunOnStack(size_t bytes, Action action) {
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
}

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_SUPPORT_SMALLSTACK_H
