#pragma once

#include <string>

namespace orlith {

/// What signals do from here on. Whichever ends the program, the unfinished file is removed first.
///
/// Ctrl-C   ends the program at once with status 130, unless a CancelScope lives
/// others   end it as they end any program (terminate, hang-up, broken pipe), unless an OrderlyEnd
///          lives
/// limits   a file that grows beyond its limit is a failed write and no signal
void catchSignals();

/// Ends the program by the signal that an OrderlyEnd has put off, if one did.
void endBySignal();

/// While one lives, Ctrl-C is a request, host::Host::cancelRequested(), and the work in hand ends
/// in order. A second Ctrl-C does not wait for that. Not nested.
class CancelScope {
public:
    CancelScope();
    CancelScope(const CancelScope&) = delete;
    CancelScope& operator=(const CancelScope&) = delete;
    ~CancelScope();

    /// From here on Ctrl-C comes too late and does not count any more.
    /// @return false if it has come in time
    bool close();

    /// From here on Ctrl-C ends the program at once: the work in hand may wait for somebody else.
    void release();
};

/// While one lives, all these signals are requests to cancel, the second and the third too: more
/// has to be put in order than a signal handler may do. The work in hand may not wait for anybody.
class OrderlyEnd {
public:
    OrderlyEnd();
    OrderlyEnd(const OrderlyEnd&) = delete;
    OrderlyEnd& operator=(const OrderlyEnd&) = delete;
    ~OrderlyEnd();
};

/// The file that a signal which ends the program removes, with the folder that was made for it.
/// One at a time; the paths are kept where a signal handler can read them.
void setUnfinishedFile(const std::string& folder, const std::string& file);
void forgetUnfinishedFile();

}  // namespace orlith
