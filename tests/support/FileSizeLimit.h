#pragma once
// The file size limit makes a write fail half way, as a full disk would, also for root.
#include <sys/resource.h>

#include <csignal>

namespace kg::test {

class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t bytes) : oldHandler_(std::signal(SIGXFSZ, SIG_IGN))
    {
        getrlimit(RLIMIT_FSIZE, &old_);
        rlimit small = old_;
        small.rlim_cur = bytes;
        setrlimit(RLIMIT_FSIZE, &small);
    }
    ~FileSizeLimit() { setrlimit(RLIMIT_FSIZE, &old_), std::signal(SIGXFSZ, oldHandler_); }

private:
    rlimit old_{};
    void (*oldHandler_)(int);
};

}  // namespace kg::test
