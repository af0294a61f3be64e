#include "instrument/MeasuringTable.h"

#include "instrument/Varo_client.h"

bool IsInstrumentOnMeasuringTable()
{
    Varo_client* client = new Varo_client;
    const bool onTable = client->CheckInstrument() == 0 && client->CheckTableMount() == 0;
    delete client;
    return onTable;
}
