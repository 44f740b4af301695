#pragma once

namespace pallax {

/// What runs the blocks of the main queue, and all that is told through it: timers, messages,
/// signals. Everything runs on the thread that calls `run` or `runReady`.
///
/// A program without another loop calls `run`. Under a loop that only has timers, `runReady` is
/// called from one of them until it returns false; a block waits until the next call at the latest,
/// so some ten milliseconds are a good interval.
class RunLoop {
public:
    virtual ~RunLoop() = default;
    /// Runs blocks, waiting for them, until `stop`. An exception of a block leaves through here;
    /// run may then be called again and goes on with the next block.
    virtual void run() = 0;
    /// Runs what is ready now, without waiting; what those blocks post included. False once after
    /// `stop`: the loop that calls it is to end. An exception leaves as from `run`.
    virtual bool runReady() = 0;
    /// Makes `run` return after the present block, or the next `run` at once; so with `runReady`.
    virtual void stop() = 0;
};

} // namespace pallax
