#pragma once

#include <Python.h>
#include <unistd.h>

namespace vorelpython {

/// While it lives, other threads of Python run, and this one touches no object of Python.
class WithoutGil {
  public:
    WithoutGil() : mState(PyEval_SaveThread()) {}
    WithoutGil(const WithoutGil&) = delete;
    WithoutGil& operator=(const WithoutGil&) = delete;

    /// An interpreter that ends ends the threads that come back to it by unwinding them, as an exception
    /// does. No destructor on the way may touch an object of Python then: such a thread, which is a
    /// daemon, stays here until the process is over.
    ~WithoutGil() {
        try {
            PyEval_RestoreThread(mState);
        } catch (...) {
            for (;;)
                ::pause();
        }
    }

  private:
    PyThreadState* mState;
};

}  // namespace vorelpython
