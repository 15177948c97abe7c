#ifndef TESTS_CONTRACT_RECORDING_HOST_RECORDINGHOST_H
#define TESTS_CONTRACT_RECORDING_HOST_RECORDINGHOST_H

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"

#include <functional>
#include <string>
#include <vector>

/** One logger call with all its arguments. */
struct LogCall {
    std::string operation; // "log" or "trace"
    std::string function;
    std::string file;
    int line;
    std::string category;
    int level;
    bool extraIsNull;
    int first;
    int second;
    std::string message;
};

/**
 * A second host, in this program in place of the reference runtime: its framework keeps nodes and
 * properties, records the plug-in's calls and fails on request.
 */
struct RecordingHost {
    /**
     * What happened, in order. Calls of the framework with their arguments, such as
     * "MutableNode(6, 5, [5], 59, 0)"; of the locks; the construction and destruction of objects
     * that are part of the plug-in's library; and messages, once each, as "log: TEXT".
     */
    std::vector<std::string> events;

    std::vector<LogCall> logCalls;

    /** Every status that was made, such as "Error(1, empty 0, \"\")"; copies not counted. */
    std::vector<std::string> errors;

    // What the framework answers.
    unsigned char initializeStatus = 0;
    unsigned char deleteNodeStatus = 0; // else the node stays
    unsigned char addNewNodeStatus = 0;
    unsigned char setterStatus = 0; // of a node's setStatus, setDescription and setProperty
    int lockStatus = 0;             // of a mutex, which is locked all the same

    /** The interface ids that initialize sets; if empty, its own. */
    std::vector<unsigned int> miIds;

    /** Called first by the framework's own initialize, unload, node constructor and setStatus. */
    std::function<void()> onInitialize;
    std::function<void()> onUnload;
    std::function<void()> onNode;
    std::function<void(IC::MutableNode&)> onSetStatus;

    /** Events without the messages. */
    std::vector<std::string> calls() const;

    /** The texts of the messages, once each. */
    std::vector<std::string> messages() const;

    /** The texts of those of one level, once each. */
    std::vector<std::string> messages(int level) const;
};

/** The one in this program. */
RecordingHost& recordingHost();

/** The same, reset to its initial state. */
RecordingHost& freshHost();

#endif
