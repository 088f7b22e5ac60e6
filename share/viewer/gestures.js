// Mouse, finger, wheel and keys.

const TAP_MS = 300;      // a second tap within this time fits the picture
const TAP_PX = 12;
const FLICK_MS = 100;    // the speed of a hand is that of its last moments
const WHEEL_ZOOM = 0.0016;
const KEY_PAN_PX = 60;

class Gestures {
    constructor(viewer) {
        this.viewer = viewer;
        this.stage = element('stage');
        this.pointers = new Map(); // those that are down
        this.track = [];           // where the hand was: [time, place]
        this.lastTap = null;
        const on = (type, act, options) => this.stage.addEventListener(type, act.bind(this), options);
        on('pointerdown', this.down);
        on('pointermove', this.move);
        on('pointerup', this.up);
        on('pointercancel', this.cancel);
        on('wheel', this.wheel, { passive: false });
        on('contextmenu', (event) => { if (event.shiftKey || this.viewer.picture.isZoomed) event.preventDefault(); });
        on('dragstart', (event) => event.preventDefault());
        document.addEventListener('keydown', this.key.bind(this));
    }

    down(event) {
        if (event.pointerType === 'mouse' && event.button === 2 && !this.viewer.picture.isZoomed) return;
        this.stage.setPointerCapture(event.pointerId);
        this.pointers.set(event.pointerId, event);
        this.moved = 0;
        this.track = [];
        this.viewer.act(() => this.viewer.motion.hold());
        this.stage.classList.add('held');
    }

    move(event) {
        this.viewer.wake();
        const before = this.pointers.get(event.pointerId);
        if (!before) return;
        const [x, y] = [event.clientX - before.clientX, event.clientY - before.clientY];
        this.moved += Math.hypot(x, y);
        if (this.pointers.size === 2) this.pinch(before, event);
        else if (this.isPanning(event)) this.pan(x, y);
        else this.drag(x, event.timeStamp);
        this.pointers.set(event.pointerId, event);
    }

    // A turntable is turned even from near; everything else is moved about.
    isPanning(event) {
        const { picture, recording } = this.viewer;
        return picture.isZoomed &&
            (recording.kind !== 'turntable' || event.shiftKey || event.buttons & 6);
    }

    pan(x, y) {
        this.viewer.picture.moveBy(x, y);
        this.viewer.draw();
    }

    // Across the whole picture: one turn, or the whole animation.
    drag(x, time) {
        const { motion, recording, picture } = this.viewer;
        motion.goTo(motion.place + recording.turn * x * recording.count / picture.wholeWidth);
        this.track.push([time, recording.turn * x]);
        while (time - this.track[0][0] > FLICK_MS) this.track.shift();
    }

    pinch(before, event) {
        const other = [...this.pointers.values()].find((pointer) => pointer.pointerId !== event.pointerId);
        const span = (pointer) => Math.hypot(pointer.clientX - other.clientX, pointer.clientY - other.clientY);
        const { picture } = this.viewer;
        picture.moveBy((event.clientX - before.clientX) / 2, (event.clientY - before.clientY) / 2);
        picture.zoomBy(span(event) / Math.max(span(before), 1),
            (event.clientX + other.clientX) / 2, (event.clientY + other.clientY) / 2);
        this.viewer.zoomed();
    }

    up(event) {
        if (!this.pointers.delete(event.pointerId)) return;
        if (this.pointers.size > 0) return;
        this.stage.classList.remove('held');
        if (this.moved < TAP_PX) this.tap(event);
        else this.letGo(event.timeStamp);
    }

    cancel(event) {
        this.pointers.delete(event.pointerId);
        this.stage.classList.remove('held');
    }

    tap(event) {
        const last = this.lastTap;
        this.lastTap = event;
        if (!last || event.timeStamp - last.timeStamp > TAP_MS ||
            Math.hypot(event.clientX - last.clientX, event.clientY - last.clientY) > 3 * TAP_PX) return;
        this.lastTap = null;
        this.viewer.fit();
    }

    // It runs on as fast as the hand was; a hand that rested before lets it stand.
    letGo(time) {
        const { motion, recording, picture, isCalm } = this.viewer;
        const recent = this.track.filter(([when]) => time - when <= FLICK_MS);
        if (isCalm || recent.length < 2) return;
        const way = recent.reduce((sum, [, x]) => sum + x, 0);
        const seconds = Math.max(time - recent[0][0], 8) / 1000;
        motion.letGo(way / seconds * recording.count / picture.wholeWidth);
    }

    // In a frame of another page the wheel is that page's, unless Ctrl says otherwise.
    wheel(event) {
        const isGuest = window !== window.top && !document.fullscreenElement;
        if (isGuest && !event.ctrlKey) return;
        event.preventDefault();
        const unit = event.deltaMode === WheelEvent.DOM_DELTA_LINE ? 30 : 1;
        const speed = event.ctrlKey ? 4 : 1; // two fingers on a pad come as small steps with Ctrl
        const step = Math.min(Math.max(event.deltaY * unit, -200), 200);
        this.viewer.act(() => {
            this.viewer.picture.zoomBy(Math.exp(-step * WHEEL_ZOOM * speed), event.clientX, event.clientY);
            this.viewer.zoomed();
        });
    }

    key(event) {
        const act = this.actionOf(event);
        if (!act) return;
        event.preventDefault();
        this.viewer.act(act);
    }

    actionOf(event) {
        const { viewer } = this;
        const { motion, picture, recording } = viewer;
        if (event.ctrlKey || event.altKey || event.metaKey || element('sheet').open) return null;
        const isInControl = event.target.closest('button, select') !== null;
        if (event.key === ' ') return isInControl ? null : () => motion.play(!motion.isPlaying);
        if (event.target.closest('select')) return null;
        const pan = { ArrowLeft: [1, 0], ArrowRight: [-1, 0], ArrowUp: [0, 1], ArrowDown: [0, -1] }[event.key];
        if (pan && event.shiftKey && picture.isZoomed) return () => this.pan(KEY_PAN_PX * pan[0], KEY_PAN_PX * pan[1]);
        const step = { ArrowLeft: -1, ArrowRight: 1, ArrowDown: -1, ArrowUp: 1,
                       PageDown: -recording.count / 12, PageUp: recording.count / 12 }[event.key];
        if (step) return () => this.goTo(motion.frame + recording.turn * Math.sign(step) * Math.max(1, Math.round(Math.abs(step))));
        return {
            Home: () => this.goTo(0),
            End: () => this.goTo(recording.count - 1),
            '+': () => this.zoomAtMiddle(1.25),
            '=': () => this.zoomAtMiddle(1.25),
            '-': () => this.zoomAtMiddle(0.8),
            '0': () => viewer.fit(),
            f: () => viewer.toggleFullScreen(),
            F: () => viewer.toggleFullScreen(),
        }[event.key] ?? null;
    }

    goTo(frame) {
        this.viewer.motion.hold();
        this.viewer.motion.goTo(frame);
    }

    zoomAtMiddle(factor) {
        this.viewer.picture.zoomAtMiddle(factor);
        this.viewer.zoomed();
    }
}
