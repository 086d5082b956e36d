// The aging record's outbox and its upload to the factory's result server. Each record is
// one JSON text kept as its own file in a device folder until the server took it: a flush
// POSTs the kept records oldest first to http://<address:port>/aging/record and deletes
// each one the server answered 2xx; the first failure stops the flush and keeps the rest
// for the next one, so a record is never lost.
#pragma once

#include <stddef.h>

// The configured endpoint "address:port" has at most this many bytes.
#define MMI_AGING_ENDPOINT_MAX 128
// Room for the URL of any endpoint that passes the check, with its terminator.
#define MMI_AGING_URL_SIZE 160

// Stores json as a new record in the device folder dir (made when missing), written
// atomically: a record is either whole or absent. 0, or -1.
int mmi_aging_upload_keep(const char *dir, const char *json);

// Sends every record of dir, oldest first, to endpoint ("address:port"). The number sent
// (0 when none is kept), or -1 when the endpoint is refused or the first send failed.
int mmi_aging_upload_flush(const char *dir, const char *endpoint);

// The number of records kept in dir (0 when it does not exist), or -1 for a null dir.
int mmi_aging_upload_pending(const char *dir);

// The record URL for endpoint into out (size bytes; "" unless 0 is returned): 0, or -1
// when out is too small or, logged, when the endpoint is empty or longer than
// MMI_AGING_ENDPOINT_MAX, lacks ":port", has a port outside 1..65535 or a character no host
// name or address has ("[v6 address]:port" is taken).
int mmi_aging_upload_url(const char *endpoint, char *out, size_t size);
