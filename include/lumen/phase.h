// Phase-coherent acquisition: receivers and ratio parameters, phase stitching across band
// breaks, the component that collects, averages and streams the data of a sweep, and the
// external phase reference device with its calibration (PRN) file.
#pragma once

#include "lumen/phase/pa_component.h"
#include "lumen/phase/pa_parameter.h"
#include "lumen/phase/pa_parameter_record.h"
#include "lumen/phase/pa_receiver.h"
#include "lumen/phase/phase_reference.h"
#include "lumen/phase/prn_reader.h"
#include "lumen/phase/stitch_phase.h"
