// Interprocess messages: the marshaling cursor with its type registry, and the messages.
#pragma once

#include "lumen/interprocess/vna_marshal_object.h"
#include "lumen/interprocess/vna_message_base.h"
#include "lumen/interprocess/vna_message_error.h"
#include "lumen/interprocess/vna_message_event.h"
#include "lumen/interprocess/vna_message_marshaling.h"
#include "lumen/interprocess/vna_message_text.h"
