#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <exception>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>
#include <vector>

#include "options.h"
#include "workbench.h"

namespace vorelpaint {

/// The threads that are asked for: as many as there are cores for this process unless the options say
/// so.
int threadsFor(const Options& options);

/// Threads that do tasks, each at a workbench of its own. Tasks are begun in the order in which they are
/// given, and are to be taken back in that order. No signal reaches the threads.
class Crew {
  public:
    using Task = std::function<void(Workbench&)>;

    /// Of one thread there is none: tasks are done where they are given. Where the system gives fewer
    /// threads than are asked for, or has no room for them, those do all.
    explicit Crew(int asked);

    /// Ends when the tasks have that were begun; the others are dropped.
    ~Crew();
    Crew(const Crew&) = delete;
    Crew& operator=(const Crew&) = delete;

    bool isEmpty() const { return mTasks.empty(); }
    bool isFull() const { return mTasks.size() >= mMost; }  ///< two tasks for each thread

    /// To be asked when it is not full. Where this throws the task is not taken.
    void give(Task task);

    /// Whether the first task is done; there is one.
    bool isFirstDone() const;

    void waitForAll() const;  ///< until every task is done

    /// Waits until the first task is done; there is one. With a file descriptor `input` also until
    /// something can be read there.
    void wait(int input = -1) const;

    /// Waits for the first task and drops it. Throws what the task threw.
    void take();

  private:
    struct Given {
        Task task;
        bool isDone = false;
        std::exception_ptr fault;
    };

    static void perform(Given& given, Workbench& bench);
    bool isDone(const Given& given) const;
    void waitFor(const Given& given, int input = -1) const;
    void work();
    void startThread();

    size_t mMost = 1;
    Workbench mBench;  ///< of the thread that gives the tasks, where it does them itself
    std::deque<std::shared_ptr<Given>> mTasks;

    mutable std::mutex mMutex;  ///< of what follows and of isDone
    std::condition_variable mChange;
    std::deque<std::shared_ptr<Given>> mWaiting;
    bool mIsOver = false;

    int mDone = -1;  ///< can be read from when a task is done
    std::vector<std::thread> mThreads;
};

}  // namespace vorelpaint
