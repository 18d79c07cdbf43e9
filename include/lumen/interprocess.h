/// @file
/// Interprocess messages: the marshaling cursor with its type registry, and the messages.
///
/// VNAMessageMarshaling writes values, strings and whole objects (their registered type index,
/// then their fields) into a byte vector and reads them back; VNAMessageError, VNAMessageEvent and
/// VNAMessageText are the messages. Reading never throws on short data: missing values read as 0,
/// strings as empty, and an unknown or missing object leaves the pointer empty.
///
/// @code
/// std::vector<unsigned char> block;
/// vna_interprocess::VNAMessageError error(0xE8060651u, 3, 7);
/// vna_interprocess::VNAMessageMarshaling(vna_interprocess::VNAMessageMarshaling::STORE, block)
///     .WriteToBuffer(&error);
/// vna_interprocess::VNAMessageMarshaling reader(vna_interprocess::VNAMessageMarshaling::LOAD,
///                                              block);
/// boost::shared_ptr<vna_interprocess::VNAMarshalObject> message;
/// reader.ReadFromBuffer(message);  // a new VNAMessageError, or empty
/// @endcode

/// @namespace vna_interprocess
/// Marshaled messages between the analyzer's processes.
#pragma once

#include "lumen/interprocess/vna_marshal_object.h"
#include "lumen/interprocess/vna_message_base.h"
#include "lumen/interprocess/vna_message_error.h"
#include "lumen/interprocess/vna_message_event.h"
#include "lumen/interprocess/vna_message_marshaling.h"
#include "lumen/interprocess/vna_message_text.h"
