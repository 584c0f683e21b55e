#include "hotfolder/HFPlugin.h"

// Defined here so that the interface's vtable and type information live in
// one place that hosts and modules share.
HFPlugin::~HFPlugin() = default;

bool HFPlugin::IsMergeEnabled()
{
    return false;
}

void HFPlugin::EnableMerge(const bool&) {}
