"""A Slurm cluster of one node on this machine, for as long as a `with` block lasts."""
import os
import pathlib
import shutil
import socket
import subprocess
import tempfile
import time

CPUS = 4  # more than the machine may have: tasks shall run side by side
COMMAND_SECONDS = 60  # for sinfo and its like, which wait long for a controller that hangs

CONFIGURATION = """
ClusterName=test
SlurmctldHost={host}(127.0.0.1)
SlurmUser=root
SlurmdUser=root
AuthType=auth/munge
AuthInfo=socket={state}/munge.socket
SlurmctldPort={ports[0]}
SlurmdPort={ports[1]}
SlurmctldPidFile={state}/slurmctld.pid
SlurmdPidFile={state}/slurmd.pid
SlurmctldLogFile={state}/slurmctld.log
SlurmdLogFile={state}/slurmd.log
StateSaveLocation={state}/controller
SlurmdSpoolDir={state}/node
ProctrackType=proctrack/pgid
TaskPlugin=task/none
JobAcctGatherType=jobacct_gather/none
AccountingStorageType=accounting_storage/none
SelectType=select/cons_tres
SelectTypeParameters=CR_Core
SlurmdParameters=config_overrides
SchedulerParameters=sched_min_interval=100000,batch_sched_delay=0
ReturnToService=2
MpiDefault=none
MailProg=/bin/true
KillWait=5
NodeName={host} NodeAddr=127.0.0.1 CPUs={cpus} State=UNKNOWN
PartitionName=all Nodes={host} Default=YES MaxTime=INFINITE State=UP
"""


def free_ports(count):
    sockets = [socket.socket() for _ in range(count)]
    for each in sockets:
        each.bind(("127.0.0.1", 0))
    ports = [each.getsockname()[1] for each in sockets]
    for each in sockets:
        each.close()
    return ports


class LocalSlurm:
    """Starts munge, the controller and the node; they end with the block."""

    def __enter__(self):
        # Short: a socket's name has a limit, and root alone may write there, as munge demands.
        self.state = pathlib.Path(tempfile.mkdtemp(prefix="slurm-", dir="/run"))
        self.daemons = []
        try:
            self._start()
        except BaseException as fault:
            self.__exit__(type(fault))
            raise
        return self

    def __exit__(self, fault=None, *_):
        if fault:
            self._tell_logs()
        self._end_jobs()
        for daemon in reversed(self.daemons):
            daemon.terminate()
        for daemon in self.daemons:
            try:
                daemon.wait(10)
            except subprocess.TimeoutExpired:
                daemon.kill()
                daemon.wait()
        shutil.rmtree(self.state, ignore_errors=True)

    def _end_jobs(self):
        """Tasks have a process of Slurm's each, which would outlive the daemons."""
        if len(self.daemons) < 3 or any(daemon.poll() is not None for daemon in self.daemons):
            return
        self.output("scancel", "--user=root", "--signal=KILL", "--full")
        self.output("scancel", "--user=root")
        end = time.monotonic() + 15
        while self.output("squeue", "-h").strip() and time.monotonic() < end:
            time.sleep(0.2)

    def _start(self):
        for name in ["controller", "node"]:
            (self.state / name).mkdir()
        key = self.state / "munge.key"
        key.write_bytes(os.urandom(128))
        key.chmod(0o400)
        self._daemon("munged", "--foreground", "--force", f"--socket={self.state}/munge.socket",
                     f"--key-file={key}", f"--pid-file={self.state}/munge.pid",
                     f"--log-file={self.state}/munge.log", f"--seed-file={self.state}/munge.seed")
        self._await("munge", lambda: (self.state / "munge.socket").exists())
        configuration = self.state / "slurm.conf"
        configuration.write_text(CONFIGURATION.format(
            state=self.state, host=socket.gethostname().split(".")[0], ports=free_ports(2),
            cpus=CPUS))
        self.environment = dict(os.environ, SLURM_CONF=str(configuration))
        self._daemon("slurmctld", "-D", "-f", str(configuration))
        self._daemon("slurmd", "-D", "-f", str(configuration))
        self._await("the node", lambda: "idle" in self.output("sinfo", "-h", "-o", "%t"))

    def _daemon(self, *command):
        log = open(self.state / (command[0] + ".out"), "wb")
        self.daemons.append(subprocess.Popen(
            command, stdin=subprocess.DEVNULL, stdout=log, stderr=subprocess.STDOUT,
            env=getattr(self, "environment", None)))

    def _await(self, what, is_there, seconds=60):
        end = time.monotonic() + seconds
        while not is_there():
            if any(daemon.poll() is not None for daemon in self.daemons):
                raise RuntimeError(f"a daemon ended while {what} was awaited")
            if time.monotonic() > end:
                raise RuntimeError(f"{what} did not come within {seconds} s")
            time.sleep(0.2)

    def _tell_logs(self):
        for log in sorted(self.state.glob("*.log")) + sorted(self.state.glob("*.out")):
            lines = log.read_text(errors="replace").splitlines()
            print(f"--- {log.name}", *lines[-15:], sep="\n")

    def output(self, *command):
        return subprocess.run(command, env=self.environment, stdout=subprocess.PIPE,
                              stderr=subprocess.STDOUT, text=True, check=False,
                              timeout=COMMAND_SECONDS).stdout

    def submit(self, directory, script, *options):
        """The number of the job."""
        result = subprocess.run(
            ["sbatch", "--parsable", "-D", str(directory), "-o", "task-%a.out", *options, "--wrap",
             script], env=self.environment, stdout=subprocess.PIPE, text=True, check=True,
            timeout=COMMAND_SECONDS)
        return result.stdout.strip()

    def wait_for_end(self, job, seconds=120):
        self._await(f"the end of job {job}",
                    lambda: not self.output("squeue", "-h", "-j", job).strip()
                    or "Invalid job id" in self.output("squeue", "-h", "-j", job), seconds)
