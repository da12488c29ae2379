// The frame round a tile of the camera grid: a unit square, as wide and high as the sensor.
uniform vec4 u_View2D;
uniform vec2 u_SensorSize;

attribute vec2 a_position;

void main()
{
	gl_Position = vec4(a_position * u_SensorSize * u_View2D.xy + u_View2D.zw, 0.0, 1.0);
}
