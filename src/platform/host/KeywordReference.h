// The reference of every keyword a setup may hold, from the declarations of the host's
// sections and the module's.
#pragma once

#include "setupeditor/Keywords.h"

#include <vector>

class CZoSEKivBase;

// Every keyword once, in the order a setup writes them.
const std::vector<KeywordEntry>& KeywordReference();

// The declarations of node and everything below it; path is the section node writes into.
void DescribeTree(CZoSEKivBase* node, const std::string& outer, KeywordSink& sink);
