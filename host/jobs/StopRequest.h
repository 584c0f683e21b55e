#pragma once

// SIGINT and SIGTERM ask the run to stop after the job in hand. The request
// is also readable as a file descriptor, so a wait can be woken by it.
namespace StopRequest
{
void Install();
bool Requested();
int WakeDescriptor(); // readable once a stop was requested
} // namespace StopRequest
