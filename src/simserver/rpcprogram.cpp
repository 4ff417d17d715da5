#include "simserver/rpcprogram.h"

#include "simserver/tirpcxdr.h"

#include <utility>

namespace kdx::simserver {
namespace {

// The library's routine for replies calls this for the results; they are appended as they are.
bool_t noResults(XDR*, ...) {
    return TRUE;
}

std::string encoded(rpc_msg& reply) {
    return toXdr<rpc_msg>(reply, xdr_replymsg);
}

std::string acceptedReply(std::uint32_t xid, accept_stat status, std::uint32_t version = 0) {
    rpc_msg reply{};
    reply.rm_xid = xid;
    reply.rm_direction = REPLY;
    reply.rm_reply.rp_stat = MSG_ACCEPTED;
    reply.acpted_rply.ar_stat = status;
    if (status == PROG_MISMATCH) {
        reply.acpted_rply.ar_vers.low = version;
        reply.acpted_rply.ar_vers.high = version;
    } else {
        reply.acpted_rply.ar_results.proc = noResults;
    }
    return encoded(reply);
}

std::string wrongRpcVersionReply(std::uint32_t xid) {
    rpc_msg reply{};
    reply.rm_xid = xid;
    reply.rm_direction = REPLY;
    reply.rm_reply.rp_stat = MSG_DENIED;
    reply.rjcted_rply.rj_stat = RPC_MISMATCH;
    reply.rjcted_rply.rj_vers.low = RPC_MSG_VERSION;
    reply.rjcted_rply.rj_vers.high = RPC_MSG_VERSION;
    return encoded(reply);
}

}  // namespace

bool RpcProgram::handle(std::string_view message, ConnectionId from, std::function<void(std::string)> send) {
    XDR stream;
    xdrmem_create(&stream, const_cast<char*>(message.data()), static_cast<u_int>(message.size()), XDR_DECODE);
    u_int xid = 0;
    u_int direction = 0;
    u_int rpcVersion = 0;
    if (!xdr_u_int(&stream, &xid) || !xdr_u_int(&stream, &direction) || direction != CALL ||
        !xdr_u_int(&stream, &rpcVersion)) {
        return false;
    }
    if (rpcVersion != RPC_MSG_VERSION) {
        send(wrongRpcVersionReply(xid));
        return true;
    }

    // Who calls is not looked at; the routine needs room for it all the same.
    char credentials[MAX_AUTH_BYTES];
    char verifier[MAX_AUTH_BYTES];
    rpc_msg head{};
    head.rm_call.cb_cred.oa_base = credentials;
    head.rm_call.cb_verf.oa_base = verifier;
    xdr_setpos(&stream, 0);
    if (!xdr_callmsg(&stream, &head)) return false;

    if (head.rm_call.cb_prog != m_number) {
        send(acceptedReply(xid, PROG_UNAVAIL));
    } else if (head.rm_call.cb_vers != m_version) {
        send(acceptedReply(xid, PROG_MISMATCH, m_version));
    } else if (head.rm_call.cb_proc == NULLPROC) {
        send(acceptedReply(xid, SUCCESS));
    } else {
        call(static_cast<std::uint32_t>(head.rm_call.cb_proc), message.substr(xdr_getpos(&stream)), from,
             [xid, send = std::move(send)](const RpcAnswer& answer) {
                 send(acceptedReply(xid, answer.status) + answer.results);
             });
    }
    return true;
}

}  // namespace kdx::simserver
