// A centroid in the picture of a camera: a unit square about the place that it was seen at, in pixels of the sensor.
uniform vec4 u_View2D;
// Place, and radius.
uniform vec3 u_Centroid;
uniform vec4 u_ModelColour;

attribute vec2 a_position;

varying vec4 v_Colour;
varying vec2 v_UV;

void main()
{
	v_Colour = u_ModelColour;
	v_UV = a_position;
	gl_Position = vec4((u_Centroid.xy + u_Centroid.z * a_position) * u_View2D.xy + u_View2D.zw, 0.0, 1.0);
}
