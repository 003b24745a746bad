#include "Port_Input.h"

namespace {

// The inputs of a thread form a stack, and live on the thread's own.
thread_local const Port_Input* innermost = nullptr;

}  // namespace

Port_Input::Port_Input(const char* fileName) noexcept : file(fileName), outer(innermost) {
  innermost = this;
}

Port_Input::~Port_Input() { innermost = outer; }

const Port_Input* Port_Input::GetCurrent() noexcept { return innermost; }
