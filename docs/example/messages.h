// What this generator keeps of the messages that the library reports.

#ifndef EXAMPLE_MESSAGES_H
#define EXAMPLE_MESSAGES_H

int reportedProblems();

#endif  // EXAMPLE_MESSAGES_H
