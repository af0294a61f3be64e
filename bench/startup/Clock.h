// What both benchmark programs print: wall-clock times comparable with the shell's
// `date +%s%N`, the thread's CPU time, and the process's peak resident memory.
#pragma once

#include <cstdio>
#include <ctime>
#include <fstream>
#include <string>

inline long long NowNs()
{
    timespec t;
    clock_gettime(CLOCK_REALTIME, &t);
    return t.tv_sec * 1000000000LL + t.tv_nsec;
}

// CPU time of the calling thread: on a busy machine it varies far less than the wall clock.
inline long long ThreadCpuUs()
{
    timespec t;
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &t);
    return t.tv_sec * 1000000LL + t.tv_nsec / 1000;
}

inline long PeakRssKb()
{
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);)
        if (line.rfind("VmHWM:", 0) == 0)
            return std::stol(line.substr(6));
    return -1;
}
