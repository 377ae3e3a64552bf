// The editor's built-in help: a short text per help id.
#pragma once

#include <QString>

struct HelpTopic {
    unsigned long id;
    const char* title;
    const char* text;  // plain paragraphs separated by blank lines
};

// Help ids of the editor's own pages of the host data.
enum HostHelpId : unsigned long {
    kHelpHostData = 9000,
    kHelpModules = 9001,
    kHelpDomain = 9002,
    kHelpBoundaries = 9003,
    kHelpPeriod = 9004,
    kHelpSources = 9005,
    kHelpDensity = 9006,
    kHelpWind = 9007,
};

// The topic of an id; unknown ids (and 0) give the general topic.
const HelpTopic& FindHelpTopic(unsigned long id);
bool HasHelpTopic(unsigned long id);
// The topic as HTML for the help pane.
QString HelpTopicHtml(unsigned long id);
// Only the topic's paragraphs, empty for an unknown id (a description under a page).
QString HelpTopicBodyHtml(unsigned long id);
