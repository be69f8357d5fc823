#ifndef _OLMA_tst_state_h
#define _OLMA_tst_state_h

// What the test module's provider does and what it saw. The test programs
// reach it through the module's exported tst_state().

#include "config.h"

namespace OLMA
{

struct Tst_State
{
    // Statuses that the provider's members return.
    int get_status;
    int enum_status;
    int create_status;
    int delete_status;
    int modify_status;
    int invoke_status;

    // How many instances enum_instances sends, and whether load() asks the
    // adapter to stay loaded.
    unsigned count;
    bool deny_unload;

    // Links: part i to part i + 1 for each part but the last, and, if asked,
    // part 0 to itself.
    bool self_link;

    // Indications: the status of enable_indications, how many alerts the
    // provider's thread is still to send, and what happened.
    int enable_status;
    unsigned pending;
    unsigned enables;
    unsigned disables;
    unsigned alerts_sent;
    unsigned refused;       // alerts that the handler didn't take
    bool stream_ended;

    // Life cycle.
    unsigned constructed;
    unsigned destructed;
    unsigned loads;
    unsigned unloads;

    // The last model or instance a member received: its keys, and how many
    // non-key properties were non-null.
    char last_op[32];
    char name[64];
    unsigned index;
    unsigned non_null;
    unsigned sent;
    bool stopped;

    // The namespace of the model that the association provider last got.
    char link_model_ns[32];

    // The last method call.
    char text[64];
    unsigned lines;
    bool user_ok;
    char user[64];
    bool thread_user_ok;
};

} // namespace OLMA

extern "C" OLMA::Tst_State* tst_state();

#endif // _OLMA_tst_state_h
