// VLThread: a wait right after Run never returns before the function has finished, failed
// thread creation leaves the object idle, and an object runs one function once.
#include <gtest/gtest.h>

#include <pthread.h>

#include <atomic>
#include <thread>
#include <vector>

#include "VLThread.h"

namespace {

// The work of one thread: it waits while the job is closed, then a short pause (so that the
// wait often has to wait), then the mark.
struct Job {
  std::atomic<bool> open{true};
  std::atomic<bool> started{false};
  std::atomic<bool> finished{false};
  unsigned long pauseMs = 0;
};

void DoJob(void* arg) {
  Job* job = static_cast<Job*>(arg);
  job->started = true;
  while (!job->open) VLThread::Sleep(1);
  VLThread::Sleep(job->pauseMs);
  job->finished = true;
}

// Several owners at once, each starting and waiting for one short thread after another. The
// running flag is up before Run returns, so a thread is running or done right after Run.
TEST(VLThread, WaitRightAfterRunNeverReturnsEarly) {
  const int kOwners = 4, kRunsEach = 16;
  std::atomic<int> early{0}, stillRunning{0}, notStarted{0}, notYetRunning{0};
  std::vector<std::thread> owners;
  for (int o = 0; o < kOwners; ++o) {
    owners.emplace_back([&, o] {
      for (int i = 0; i < kRunsEach; ++i) {
        Job job;
        job.pauseMs = (o + i) % 3;  // 0, 1 or 2 ms
        VLThread* t = VLThread::CreateThread();
        if (!t->Run("job", DoJob, &job)) {
          ++notStarted;
        } else {
          if (!t->IsRunning() && !job.finished) ++notYetRunning;
          t->WaitUntilCompletion();
          if (!job.finished) ++early;
          if (t->IsRunning()) ++stillRunning;
        }
        VLThread::DestroyThread(t);
      }
    });
  }
  for (std::thread& owner : owners) owner.join();
  EXPECT_EQ(0, notStarted.load());
  EXPECT_EQ(0, notYetRunning.load());
  EXPECT_EQ(0, early.load());
  EXPECT_EQ(0, stillRunning.load());
}

// Makes thread creation fail for the scope: no default stack of this size can be mapped.
class ImpossibleStacks {
 public:
  ImpossibleStacks() {
    pthread_getattr_default_np(&m_Saved);
    pthread_attr_t huge;
    pthread_attr_init(&huge);
    pthread_attr_setstacksize(&huge, static_cast<size_t>(1) << 46);
    pthread_setattr_default_np(&huge);
    pthread_attr_destroy(&huge);
  }
  ~ImpossibleStacks() {
    pthread_setattr_default_np(&m_Saved);
    pthread_attr_destroy(&m_Saved);
  }

 private:
  pthread_attr_t m_Saved;
};

TEST(VLThread, NeverStartedOrFailedThreadIsIdle) {
  Job job;
  VLThread* t = VLThread::CreateThread();
  EXPECT_FALSE(t->IsRunning());
  t->WaitUntilCompletion();  // returns at once
  {
    ImpossibleStacks noThreads;
    ASSERT_FALSE(t->Run("job", DoJob, &job));
  }
  EXPECT_FALSE(t->IsRunning());
  t->WaitUntilCompletion();
  EXPECT_FALSE(job.started);
  ASSERT_TRUE(t->Run("job", DoJob, &job));  // still idle: it may be run now
  t->WaitUntilCompletion();
  EXPECT_TRUE(job.finished);
  VLThread::DestroyThread(t);

  VLThread* noFunction = VLThread::CreateThread();
  EXPECT_FALSE(noFunction->Run("none", nullptr, nullptr));
  EXPECT_FALSE(noFunction->IsRunning());
  VLThread::DestroyThread(noFunction);
  VLThread::DestroyThread(nullptr);
}

TEST(VLThread, DestroyingARunningThreadLeavesItsRecordToTheThread) {
  Job job;
  job.open = false;
  VLThread* t = VLThread::CreateThread();
  ASSERT_TRUE(t->Run("closed", DoJob, &job));
  EXPECT_TRUE(t->IsRunning());
  VLThread::DestroyThread(t);  // the thread still writes its flag when it ends
  job.open = true;
  while (!job.finished) VLThread::Sleep(1);
  VLThread::Sleep(20);  // let it finish its last write (checked by the sanitizer build)
}

TEST(VLThreadDeathTest, RunsOnlyOnce) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  Job job;
  VLThread* t = VLThread::CreateThread();
  ASSERT_TRUE(t->Run("job", DoJob, &job));
  t->WaitUntilCompletion();
  EXPECT_DEATH(t->Run("again", DoJob, &job), "m_Impl->m_Thread == 0");
  VLThread::DestroyThread(t);
}

}  // namespace
