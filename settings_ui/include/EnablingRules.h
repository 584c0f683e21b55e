#pragma once
#include <utility>
#include <vector>

// Enable/disable requests in the order the rules issue them; a later request
// for the same control wins. Kept apart from the windows so the rules can be
// checked without a display.
using EnableRequests = std::vector<std::pair<int, bool>>;

// The final state asked for one control: 1 enabled, 0 disabled, -1 untouched.
int RequestedState(const EnableRequests& requests, int id);

// Image section rules. Each appends its requests.
void CustomSizeSelectionRule(EnableRequests& out, bool enable, bool widthDrives, bool heightDrives);
void ConstrainSelectionRule(EnableRequests& out, bool on, bool customSize, bool widthDrives,
                            bool heightDrives);
void AutoScaleSelectionRule(EnableRequests& out, bool on);
void WidthHeightRule(EnableRequests& out, bool width);

// Output section: every page and image control switched together.
void PageAndImageGroupRule(EnableRequests& out, bool enable);
