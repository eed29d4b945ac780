// The epoll sets behind the transport's native wait handles: a server's
// listen handle and an accepted connection's ready handle are each one epoll
// descriptor over a socket and an eventfd, so a single descriptor polls ready
// for either.
#pragma once

namespace hsdig::transport {

// Reports "TManualResetEvent unable to create event, GLE=" with `error` and
// throws SystemResourceException "CreateEvent failed": what a wait handle
// that cannot be made gives.
[[noreturn]] void eventCreationFailed(int error);

// Adds `fd` (readable) to the epoll set `waitSet`; fails as above.
void addToWaitSet(int waitSet, int fd);

}  // namespace hsdig::transport
