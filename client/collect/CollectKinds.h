#pragma once

#include "client/collect/TCollection.h"

namespace NORVZEL20 {

/// The kinds of things that are collected, a function each. What cannot be read is left out and noted in the collection.
/// Errors: those of TCollection::Add.

/// KALMO_ComputerSystem and KALMO_OperatingSystem.
void CollectSystem(TCollection& collection);
void CollectProcessors(TCollection& collection);
/// KALMO_Memory and KALMO_SwapArea.
void CollectMemory(TCollection& collection);
/// KALMO_Disk and KALMO_DiskPartition.
void CollectDisks(TCollection& collection);
void CollectMounts(TCollection& collection);
/// KALMO_NetworkAdapter, KALMO_IPEndpoint and KALMO_Route.
void CollectNetwork(TCollection& collection);
/// Of dpkg and of rpm.
void CollectPackages(TCollection& collection);
void CollectUnits(TCollection& collection);
/// KALMO_KernelModule and KALMO_KernelParameter.
void CollectKernel(TCollection& collection);
/// KALMO_User and KALMO_Group.
void CollectUsers(TCollection& collection);
void CollectJobs(TCollection& collection);
void CollectSockets(TCollection& collection);
void CollectFiles(TCollection& collection);
void CollectCertificates(TCollection& collection);

}  // namespace NORVZEL20
